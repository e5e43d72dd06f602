#include "Sections/Shared/PDPContextList.h"

#include "LogGenerator/Template/PropertyListReaders.h"
#include "Platform/SystemLog.h"

namespace spectrel {

PDPContextList::PDPContextList(ClassDictionary& dict, CodeDictionary& codeDict)
{
    enterInto(dict, codeDict);
}

std::string_view PDPContextList::getSectionName() const
{
    return "PDP Context Info";
}

std::vector<std::uint32_t> PDPContextList::getLogCodeArray() const
{
    return {ContextArrayReader::Code};
}

void PDPContextList::updateWithData(RecordView record, std::uint32_t)
{
    SPECTREL_LOG(Priority::Warning, "PDPContextList");
    const ContextArrayReader reader(record);
    if (reader.contexts() && sectionRef.list())
        replaceArray(*sectionRef.list(), *reader.contexts());
}

} // namespace spectrel
