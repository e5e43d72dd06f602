#include "LogGenerator/CDMA/PilotLists.h"

#include "LogGenerator/CDMA/Decoders.h"
#include "LogGenerator/CDMA/DisplayTexts.h"
#include "LogGenerator/CDMA/Lookup.h"
#include "Platform/SystemLog.h"
#include "Values/TextBuffer.h"

namespace spectrel {

namespace {

constexpr double FullScale = 512; // of energies: 0 dB
constexpr std::uint16_t UnassignedPN = 0xFFFF;

/// 0x12B6. Head, then one block a pilot.
namespace ActiveSet {
constexpr unsigned long HeadLength = 25;
constexpr std::size_t Count = 15;
constexpr std::size_t BlockLength = 12;
constexpr std::size_t PN = 0; // in a block
constexpr std::size_t Energy = 2;
} // namespace ActiveSet

/// 0x108A. Head, then one block a finger.
namespace Fingers {
constexpr unsigned long HeadLength = 23;
constexpr std::size_t Count = 22;
constexpr std::size_t BlockLength = 14;
constexpr std::size_t PN = 0; // in a block
constexpr std::size_t CarrierToInterference = 6;
} // namespace Fingers

void addPilot(PilotList& list, std::size_t index, std::uint16_t pn, std::uint16_t energy)
{
    TextBuffer buffer;
    list.add(index, pn, decibels(energy / FullScale, buffer));
}

} // namespace

PilotList::PilotList()
    : _pilots(Dictionary::make({{"_sorted", "_sorted"}}))
{
}

void PilotList::add(std::size_t index, std::uint16_t pn, std::string_view strength)
{
    TextBuffer key;
    _pilots->set(key.decimal(static_cast<std::int64_t>(index)).text(";").decimal(pn).view(), strength);
}

Value PilotList::pilotsOrNone() const
{
    return _pilots->count() > 1 ? Value(_pilots) : Value("(none)");
}

void decodeActiveSetPilots(SystemLog& log, RecordView record, Dictionary&, const Value& lookup)
{
    using namespace ActiveSet;
    const auto length = static_cast<unsigned>(record.size());
    if (length < HeadLength) {
        SPECTREL_LOG(log, Priority::Error, "Log code 0x12b6 is %u bytes long but must be at least %lu bytes.", length,
            HeadLength);
        return;
    }
    const std::size_t count = record.u8(Count);
    if (length < HeadLength + BlockLength * count) {
        SPECTREL_LOG(log, Priority::Error, "Log code 0x12b6 is %u bytes long, but has %d substructs.", length,
            static_cast<int>(count));
        return;
    }
    PilotList list;
    for (std::size_t index = 0; index < count; ++index) {
        const std::size_t block = HeadLength + BlockLength * index;
        addPilot(list, index, record.u16(block + PN), record.u16(block + Energy));
    }
    setLookupValue("kActiveSetPilots", list.pilotsOrNone(), lookup);
}

void decodeFingers(SystemLog& log, RecordView record, Dictionary&, const Value& lookup)
{
    using namespace Fingers;
    const auto length = static_cast<unsigned>(record.size());
    if (length < HeadLength) {
        SPECTREL_LOG(log, Priority::Error, "Log code 0x108a is %u bytes long but must be at least %lu bytes.", length,
            HeadLength);
        return;
    }
    const std::size_t count = record.u8(Count);
    if (length != HeadLength + BlockLength * count) {
        SPECTREL_LOG(log, Priority::Error,
            "Log code 0x108a has bad length of %u bytes, but has %d substructs (size=%lu).", length,
            static_cast<int>(count), HeadLength);
        return;
    }
    PilotList list;
    for (std::size_t index = 0; index < count; ++index) {
        const std::size_t block = HeadLength + BlockLength * index;
        const std::uint16_t pn = record.u16(block + PN);
        if (pn != UnassignedPN)
            addPilot(list, index, pn, record.u16(block + CarrierToInterference));
    }
    setLookupValue("kFingerC2I", list.pilotsOrNone(), lookup);
}

} // namespace spectrel
