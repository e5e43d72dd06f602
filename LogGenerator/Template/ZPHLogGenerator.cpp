#include "LogGenerator/Template/ZPHLogGenerator.h"

#include "LogGenerator/Template/DLFVersionReport.h"
#include "Platform/ProgramInformation.h"
#include "Platform/SystemLog.h"

#include <string>
#include <utility>

namespace spectrel {

namespace {

// Not this program's name and not the day of its build: DLF files have always had these, and files of two builds are
// the same byte for byte.
constexpr const char* ExecutableName = "EXECUTABLE_NAME";
constexpr const char* BuildDate = "Dec  9 2019 21:26:56";

DLFResult writeVersionReport(Bytes& dlf, const Clock& clock)
{
    const Moment now = clock.now();
    std::uint32_t bytesWritten = 0;
    return DLFAddVersionReport(dlf, bytesWritten, 1, 1, "Spectrel " + programVersion().value_or("(none)"),
        ExecutableName, BuildDate, makeDLFTimeWord(now, clock.zoneAt(now)));
}

} // namespace

void ZPHLogGenerator::init()
{
    LogGenerator::init();
    _binData = std::make_shared<Bytes>();
}

void ZPHLogGenerator::takeOver(LogGenerator* predecessor, Dictionary&)
{
    if (auto* earlier = dynamic_cast<ZPHLogGenerator*>(predecessor); earlier && earlier->_binData)
        _binData = std::move(earlier->_binData);
}

void ZPHLogGenerator::discardRawMessages()
{
    if (_binData)
        _binData->clear();
}

void ZPHLogGenerator::keepRawMessage(ByteView data)
{
    if (_binData)
        _binData->insert(_binData->end(), data.begin(), data.end());
}

void ZPHLogGenerator::handOverRawMessages(Dictionary& state)
{
    state.set(StateKey::DisplayState, DataRef(std::exchange(_binData, std::make_shared<Bytes>())));
}

DataRef ZPHLogGenerator::generateDlfFromState(const Dictionary& state) const
{
    auto dlf = std::make_shared<Bytes>(DLFVersionReportSize);
    if (const auto result = writeVersionReport(*dlf, context().clock); result != DLFResult::Written) {
        SPECTREL_LOG(
            log(), Priority::SnapshotWriter, "Could not write DLF header (result=%d)", static_cast<int>(result));
        return nullptr;
    }
    const auto& history = state[StateKey::History].list();
    if (!history)
        return dlf;
    for (const Value& entry : history->elements()) {
        const Value& raw = entry.dictionary() ? (*entry.dictionary())[StateKey::DisplayState] : entry;
        if (raw.isAbsent())
            continue;
        if (!raw.data()) {
            SPECTREL_LOG(log(), Priority::SnapshotWriter,
                "Got wrong class writing history to DLF; aborting writing the DLF file");
            return nullptr;
        }
        // Only the buffer's very first type byte goes; those of further records stay in the file.
        if (raw.data()->size() >= 2)
            dlf->insert(dlf->end(), raw.data()->begin() + 1, raw.data()->end());
    }
    return dlf;
}

ListRef ZPHLogGenerator::getSaveContentsFromState(const Dictionary& state)
{
    const auto& history = state[StateKey::History].list();
    ListRef contents = history ? history->copy() : List::make();
    if (const DataRef dlf = generateDlfFromState(state)) {
        contents->append(Dictionary::make({
            {"Description", "DLF binary (" + std::to_string(dlf->size()) + " bytes)"},
            {"DLF", dlf},
        }));
    }
    return contents;
}

} // namespace spectrel
