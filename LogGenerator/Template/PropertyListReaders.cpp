#include "LogGenerator/Template/PropertyListReaders.h"

#include "Platform/SystemLog.h"
#include "Records/Frame.h"
#include "Records/TelephonyConstants.h"
#include "Values/Dictionary.h"
#include "Values/PropertyList/PropertyList.h"

#include <algorithm>

namespace spectrel {

namespace {

const Value NoValue;

bool isText(const Value& value, std::string_view text)
{
    const std::string* string = value.string();
    return string && *string == text;
}

/// The elements of a list; a value that is none has no elements.
std::span<const Value> elementsOf(const Value& value)
{
    const auto& list = value.list();
    return list ? std::span<const Value>(list->elements()) : std::span<const Value>();
}

bool isOfAny(const Dictionary& cell, std::span<const std::string_view> technologies)
{
    const Value& technology = cell[kRKCellMonitorCellRadioAccessTechnology];
    return std::ranges::any_of(
        technologies, [&technology](std::string_view wanted) { return !wanted.empty() && isText(technology, wanted); });
}

std::vector<DictionaryRef> cellsOf(
    const Value& value, std::span<const std::string_view> technologies, std::string_view type)
{
    std::vector<DictionaryRef> cells;
    for (const Value& element : elementsOf(value)) {
        const auto& cell = element.dictionary();
        if (cell && isOfAny(*cell, technologies) && isText((*cell)[kRKCellMonitorCellType], type))
            cells.push_back(cell);
    }
    return cells;
}

} // namespace

PropertyListPayloads::Payload& PropertyListPayloads::latestOf(std::uint32_t code)
{
    const auto found = std::ranges::find(_latest, code, &Payload::code);
    return found == _latest.end() ? _latest.emplace_back(Payload {code, {}, {}}) : *found;
}

const Value& PropertyListPayloads::of(RecordView record)
{
    const ByteView bytes = recordPayload(record);
    Payload& latest = latestOf(routingCode(record));
    if (!std::ranges::equal(bytes, latest.bytes)) {
        readPropertyList(bytes, latest.parsed);
        latest.bytes.assign(bytes.begin(), bytes.end());
    }
    return latest.parsed;
}

LogCode_0xFF0000::LogCode_0xFF0000(RecordView record, PropertyListPayloads& payloads, SystemLog& log)
    : _files(payloads.of(record))
{
    if (_files.isAbsent()) {
        SPECTREL_LOG(log, Priority::Error, "SIM File dictionary data could not be constructed");
        throw UnknownDataException();
    }
}

const Value& LogCode_0xFF0000::operator[](std::string_view key) const
{
    const auto& dictionary = _files.dictionary();
    return dictionary ? (*dictionary)[key] : NoValue;
}

ContextArrayReader::ContextArrayReader(RecordView record, PropertyListPayloads& payloads)
    : _contexts(payloads.of(record).list())
{
}

CellInfoArrayReader::CellInfoArrayReader(RecordView record, PropertyListPayloads& payloads, SystemLog& log)
    : _cells(payloads.of(record))
{
    if (_cells.isAbsent())
        SPECTREL_LOG(log, Priority::Error, "Cell Info Array data could not be constructed");
}

std::vector<DictionaryRef> CellInfoArrayReader::servingCells(std::span<const std::string_view> technologies) const
{
    return cellsOf(_cells, technologies, kRKCellMonitorCellTypeServing);
}

std::vector<DictionaryRef> CellInfoArrayReader::neighborCells(std::span<const std::string_view> technologies) const
{
    return cellsOf(_cells, technologies, kRKCellMonitorCellTypeNeighbor);
}

} // namespace spectrel
