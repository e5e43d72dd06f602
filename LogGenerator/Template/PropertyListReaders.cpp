#include "LogGenerator/Template/PropertyListReaders.h"

#include "Platform/Dictionary.h"
#include "Platform/PropertyList.h"
#include "Platform/SystemLog.h"
#include "Platform/TelephonyConstants.h"

namespace spectrel {

namespace {

const Value NoValue;

bool isText(const Value& value, std::string_view text)
{
    const std::string* string = value.string();
    return string && *string == text;
}

} // namespace

LogCode_0xFF0000::LogCode_0xFF0000(RecordView record)
{
    auto files = parsePropertyList(record.payload());
    if (!files) {
        SPECTREL_LOG(Priority::Error, "SIM File dictionary data could not be constructed");
        throw UnknownDataException();
    }
    _files = std::move(*files);
}

const Value& LogCode_0xFF0000::operator[](std::string_view key) const
{
    const auto& dictionary = _files.dictionary();
    return dictionary ? (*dictionary)[key] : NoValue;
}

ContextArrayReader::ContextArrayReader(RecordView record)
{
    if (const auto contexts = parsePropertyList(record.payload()))
        _contexts = contexts->list();
}

CellInfoArrayReader::CellInfoArrayReader(RecordView record)
{
    if (auto cells = parsePropertyList(record.payload()))
        _cells = std::move(*cells);
    else
        SPECTREL_LOG(Priority::Error, "Cell Info Array data could not be constructed");
}

DictionaryRef CellInfoArrayReader::firstServingCell(std::string_view radioAccessTechnology) const
{
    const auto& cells = _cells.list();
    if (!cells)
        return nullptr;
    for (const Value& element : cells->elements()) {
        const auto& cell = element.dictionary();
        if (cell && isText((*cell)[kRKCellMonitorCellRadioAccessTechnology], radioAccessTechnology)
            && isText((*cell)[kRKCellMonitorCellType], kRKCellMonitorCellTypeServing))
            return cell;
    }
    return nullptr;
}

} // namespace spectrel
