#include "LogGenerator/Template/CodeDictionary.h"

namespace spectrel {

void CodeDictionary::subscribe(std::uint32_t code, Base& section)
{
    const auto [entry, isNew] = _subscribers.try_emplace(code);
    if (isNew)
        _codes.push_back(code);
    entry->second.push_back(&section);
}

const Subscribers* CodeDictionary::subscribers(std::uint32_t code) const
{
    const auto found = _subscribers.find(code);
    return found == _subscribers.end() ? nullptr : &found->second;
}

std::vector<std::string> CodeDictionary::allKeys() const
{
    std::vector<std::string> keys;
    keys.reserve(_codes.size());
    for (const std::uint32_t code : _codes)
        keys.push_back(std::to_string(static_cast<std::int32_t>(code)));
    return keys;
}

} // namespace spectrel
