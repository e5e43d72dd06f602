#include "LogGenerator/Template/RecordSection.h"

#include "Platform/SystemLog.h"

namespace spectrel {

RecordSection::RecordSection(const RecordKind& kind, ClassDictionary& dict, CodeDictionary& codeDict)
    : _kind(kind)
{
    enterInto(dict, codeDict);
}

void RecordSection::updateWithData(RecordView record, std::uint32_t logCode)
{
    SPECTREL_LOG(_kind.tracePriority, "%.*s", static_cast<int>(_kind.trace.size()), _kind.trace.data());
    if (logCode != _kind.code) {
        if (_kind.unknownCode == UnknownCode::Logged)
            logUnknownMessage(logCode);
        return;
    }
    if (record.size() >= _kind.minimumLength)
        decode(record);
}

void RecordSection::clearList()
{
    if (const auto& list = sectionRef.list())
        clearElementsInArray(*list);
}

void RecordSection::replaceList(const List& elements)
{
    if (const auto& list = sectionRef.list())
        replaceArray(*list, elements);
}

} // namespace spectrel
