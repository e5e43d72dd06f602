#include "Values/Rewriting.h"

namespace spectrel {

namespace {

constexpr std::size_t FirstCapacity = 8; // entries or elements

/// One of 64: keys with different marks are different.
std::uint64_t markOf(std::string_view key)
{
    if (key.empty())
        return 1;
    const auto character = [key](std::size_t at) { return static_cast<unsigned char>(key[at]); };
    const std::size_t mixed =
        key.size() + 5u * character(key.size() - 1) + 11u * character(key.size() / 2) + 23u * character(0);
    return std::uint64_t(1) << (mixed & 63);
}

} // namespace

Value& DictionaryRewriting::slot(std::string_view key)
{
    if (_written < _entries.size() && _entries[_written].key == key)
        return _entries[_written++].value;
    return slotOfOther(key);
}

/// From the first key on that is not the earlier one, the earlier entries go.
Value& DictionaryRewriting::slotOfOther(std::string_view key)
{
    if (_seen == 0) {
        _entries.resize(_written);
        for (const Dictionary::Entry& entry : _entries)
            _seen |= markOf(entry.key);
    }
    const std::uint64_t mark = markOf(key);
    if (_seen & mark) {
        for (Dictionary::Entry& entry : _entries) {
            if (entry.key == key)
                return entry.value;
        }
    }
    _seen |= mark;
    if (_entries.capacity() == _entries.size())
        _entries.reserve(_entries.empty() ? FirstCapacity : 2 * _entries.size());
    _entries.emplace_back();
    _entries.back().key = key;
    ++_written;
    return _entries.back().value;
}

Dictionary& dictionaryToRewrite(Value& value)
{
    if (const auto& held = value.dictionary(); held && held.use_count() == 1 && !held->observer())
        return *held;
    value = std::make_shared<Dictionary>();
    return *value.dictionary();
}

List& listToRewrite(Value& value)
{
    if (const auto& held = value.list(); held && held.use_count() == 1 && !held->observer())
        return *held;
    value = std::make_shared<List>();
    return *value.list();
}

} // namespace spectrel
