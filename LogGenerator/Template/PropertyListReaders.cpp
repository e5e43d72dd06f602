#include "LogGenerator/Template/PropertyListReaders.h"

#include "Platform/SystemLog.h"
#include "Records/Frame.h"
#include "Records/TelephonyConstants.h"
#include "Values/Dictionary.h"
#include "Values/PropertyList/PropertyList.h"

#include <algorithm>
#include <optional>
#include <span>

namespace spectrel {

namespace {

const Value NoValue;

/// The payload's property list; none when it does not parse. The latest is kept: several sections read the same
/// record one after the other, and many a record tells what the one before it told. Whoever holds its nodes only reads
/// them.
const std::optional<Value>& parsedPayload(RecordView record)
{
    static Bytes latest;
    static std::optional<Value> parsed;
    const ByteView payload = recordPayload(record);
    if (!std::ranges::equal(payload, latest)) {
        parsed = parsePropertyList(payload);
        latest.assign(payload.begin(), payload.end());
    }
    return parsed;
}

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

bool isCell(const Value& value, std::string_view technology, std::string_view type)
{
    const auto& cell = value.dictionary();
    return cell && isText((*cell)[kRKCellMonitorCellRadioAccessTechnology], technology)
        && isText((*cell)[kRKCellMonitorCellType], type);
}

std::vector<DictionaryRef> cellsOf(const Value& value, std::string_view technology, std::string_view type)
{
    std::vector<DictionaryRef> cells;
    for (const Value& element : elementsOf(value)) {
        if (isCell(element, technology, type))
            cells.push_back(element.dictionary());
    }
    return cells;
}

} // namespace

LogCode_0xFF0000::LogCode_0xFF0000(RecordView record)
{
    const auto& files = parsedPayload(record);
    if (!files) {
        SPECTREL_LOG(Priority::Error, "SIM File dictionary data could not be constructed");
        throw UnknownDataException();
    }
    _files = *files;
}

const Value& LogCode_0xFF0000::operator[](std::string_view key) const
{
    const auto& dictionary = _files.dictionary();
    return dictionary ? (*dictionary)[key] : NoValue;
}

ContextArrayReader::ContextArrayReader(RecordView record)
{
    if (const auto& contexts = parsedPayload(record))
        _contexts = contexts->list();
}

CellInfoArrayReader::CellInfoArrayReader(RecordView record)
{
    if (const auto& cells = parsedPayload(record))
        _cells = *cells;
    else
        SPECTREL_LOG(Priority::Error, "Cell Info Array data could not be constructed");
}

DictionaryRef CellInfoArrayReader::firstServingCell(
    std::initializer_list<std::string_view> radioAccessTechnologies) const
{
    for (const Value& element : elementsOf(_cells)) {
        for (const std::string_view technology : radioAccessTechnologies) {
            if (isCell(element, technology, kRKCellMonitorCellTypeServing))
                return element.dictionary();
        }
    }
    return nullptr;
}

std::vector<DictionaryRef> CellInfoArrayReader::servingCells(std::string_view radioAccessTechnology) const
{
    return cellsOf(_cells, radioAccessTechnology, kRKCellMonitorCellTypeServing);
}

std::vector<DictionaryRef> CellInfoArrayReader::neighborCells(std::string_view radioAccessTechnology) const
{
    return cellsOf(_cells, radioAccessTechnology, kRKCellMonitorCellTypeNeighbor);
}

} // namespace spectrel
