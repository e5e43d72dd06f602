#include "Values/Dictionary.h"

#include "Values/List.h"

#include <cstdint>
#include <cstring>
#include <set>

namespace spectrel {

namespace {

const Value NoValue;
constexpr std::size_t NotFound = static_cast<std::size_t>(-1);

/// Above this many entries a search goes through the sorted index; below, a walk is faster.
constexpr std::size_t LargestWalked = 48;

std::uint64_t wordAt(const char* place)
{
    std::uint64_t word;
    std::memcpy(&word, place, sizeof word);
    return word;
}

/// Whether two texts are equal: keys are short, so that the call of a general comparison would cost more than itself.
bool isSame(std::string_view left, std::string_view right)
{
    const std::size_t size = left.size();
    if (size != right.size())
        return false;
    if (size < sizeof(std::uint64_t)) {
        for (std::size_t at = 0; at < size; ++at) {
            if (left[at] != right[at])
                return false;
        }
        return true;
    }
    const std::size_t lastWord = size - sizeof(std::uint64_t);
    for (std::size_t at = 0; at < lastWord; at += sizeof(std::uint64_t)) {
        if (wordAt(left.data() + at) != wordAt(right.data() + at))
            return false;
    }
    return wordAt(left.data() + lastWord) == wordAt(right.data() + lastWord);
}

/// Orders positions by the keys they hold; a text finds its position without being copied.
struct ByKey {
    using is_transparent = void;
    const std::vector<Dictionary::Entry>* entries;

    bool operator()(std::size_t left, std::size_t right) const
    {
        return (*entries)[left].key < (*entries)[right].key;
    }
    bool operator()(std::size_t left, std::string_view right) const
    {
        return (*entries)[left].key < right;
    }
    bool operator()(std::string_view left, std::size_t right) const
    {
        return left < (*entries)[right].key;
    }
};

} // namespace

struct Dictionary::Index : std::set<std::size_t, ByKey> {
    using set::set;
};

Dictionary::Dictionary() = default;

Dictionary::Dictionary(std::initializer_list<Entry> entries)
{
    for (const Entry& entry : entries)
        set(entry.key, entry.value);
}

Dictionary::~Dictionary() = default;

DictionaryRef Dictionary::make(std::initializer_list<Entry> entries)
{
    return std::make_shared<Dictionary>(entries);
}

/// The entries, with nothing remembered of where they stand.
std::vector<Dictionary::Entry>& Dictionary::entriesToRewrite()
{
    _index.reset();
    _next = 0;
    return _entries;
}

std::size_t Dictionary::positionOf(std::string_view key) const
{
    const std::size_t count = _entries.size();
    if (_next < count && isSame(_entries[_next].key, key))
        return _next++;
    if (count > LargestWalked) {
        if (!_index) {
            _index = std::make_unique<Index>(ByKey {&_entries});
            for (std::size_t position = 0; position < count; ++position)
                _index->insert(position);
        }
        const auto found = _index->find(key);
        if (found == _index->end())
            return NotFound;
        _next = *found + 1;
        return *found;
    }
    for (std::size_t position = 0; position < count; ++position) {
        if (isSame(_entries[position].key, key)) {
            _next = position + 1;
            return position;
        }
    }
    return NotFound;
}

std::size_t Dictionary::append(std::string_view key, Value value)
{
    const std::size_t position = _entries.size();
    Entry& entry = _entries.emplace_back();
    entry.key = key;
    entry.value = std::move(value);
    if (_index)
        _index->insert(position);
    _next = 0;
    return position;
}

const Value& Dictionary::operator[](std::string_view key) const
{
    const std::size_t position = positionOf(key);
    return position == NotFound ? NoValue : _entries[position].value;
}

bool Dictionary::contains(std::string_view key) const
{
    return positionOf(key) != NotFound;
}

void Dictionary::set(std::string_view key, Value value)
{
    if (value.isAbsent())
        return remove(key);
    const std::size_t position = positionOf(key);
    if (_observer)
        _observer->willStore(key, position == NotFound ? NoValue : _entries[position].value, value);
    if (position == NotFound)
        append(key, std::move(value));
    else
        _entries[position].value = std::move(value);
}

void Dictionary::setText(std::string_view key, std::string_view text)
{
    const std::size_t position = positionOf(key);
    if (_observer)
        _observer->willStoreText(key, position == NotFound ? NoValue : _entries[position].value, text);
    if (position == NotFound)
        append(key, Value(text));
    else
        _entries[position].value.assignText(text);
}

void Dictionary::remove(std::string_view key)
{
    const std::size_t position = positionOf(key);
    if (position == NotFound)
        return;
    if (_observer)
        _observer->willRemove(key, _entries[position].value);
    _index.reset(); // positions behind the gap move up
    _entries.erase(_entries.begin() + static_cast<std::ptrdiff_t>(position));
    _next = position;
}

void Dictionary::removeAll()
{
    if (_observer) {
        for (const Entry& entry : _entries)
            _observer->willRemove(entry.key, entry.value);
    }
    _index.reset();
    _entries.clear();
    _next = 0;
}

DictionaryRef Dictionary::copy() const
{
    auto copied = make();
    copied->_entries = _entries;
    return copied;
}

Value copyTopLevel(const Value& value)
{
    if (const auto& dictionary = value.dictionary())
        return dictionary->copy();
    if (const auto& list = value.list())
        return list->copy();
    return value;
}

} // namespace spectrel
