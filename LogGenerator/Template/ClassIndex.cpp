#include "LogGenerator/Template/ClassIndex.h"

#include "Platform/Console.h"
#include "Platform/SystemLog.h"

namespace spectrel {

ClassIndex::~ClassIndex()
{
    consoleLine("Deallocing ClassIndex");
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
    SPECTREL_LOG(Priority::Warning, "Dictionary = %d", 1);
    SPECTREL_LOG(Priority::Warning, "String = %d", 0);
}

} // namespace spectrel
