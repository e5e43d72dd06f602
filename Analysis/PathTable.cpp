#include "Analysis/PathTable.h"

namespace spectrel {

PathNumber PathTable::numberOf(std::string_view path)
{
    if (const auto known = _numbers.find(path); known != _numbers.end())
        return known->second;
    const auto number = static_cast<PathNumber>(_paths.size() + 1);
    _numbers.emplace(_paths.emplace_back(path), number);
    return number;
}

const std::string& PathTable::pathOf(PathNumber number) const
{
    static const std::string none;
    return number == 0 ? none : _paths[number - 1];
}

} // namespace spectrel
