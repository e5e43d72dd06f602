#include "LogGenerator/Template/ClassIndex.h"

namespace spectrel {

ClassIndex::ClassIndex(const Context& given)
    : SectionRegistry(given)
{
}

ClassIndex::~ClassIndex()
{
    context.console.line("Deallocing ClassIndex");
}

Base* ClassIndex::getClass(std::string_view name) const
{
    const auto found = classDict.find(name);
    return found == classDict.end() ? nullptr : found->second;
}

std::vector<std::string> ClassIndex::getAllLogCodes() const
{
    return codeDictionary.allKeys();
}

void ClassIndex::status() const
{
    SPECTREL_LOG(context.log, Priority::Warning, "Dictionary = %d", 1);
    SPECTREL_LOG(context.log, Priority::Warning, "String = %d", 0);
}

} // namespace spectrel
