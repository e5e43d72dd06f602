#pragma once

#include "Values/Dictionary.h"
#include "Values/List.h"

#include <cstddef>
#include <cstdint>
#include <string_view>

namespace spectrel {

/// Writes a dictionary's entries anew, in order, over those that it held before: what has the key that it had the last
/// time keeps its place and memory. Only for a dictionary that nobody else holds and nobody observes.
class DictionaryRewriting {
public:
    /// `dictionary` outlives this.
    explicit DictionaryRewriting(Dictionary& dictionary)
        : _entries(dictionary.entriesToRewrite())
    {
    }

    /// The value to be written under the key: the earlier one at this place, or the one that this writing gave to the
    /// same key before. Valid until the next call.
    Value& slot(std::string_view key);
    /// Drops the earlier entries that were not written again.
    void finish()
    {
        _entries.resize(_written);
    }

private:
    Value& slotOfOther(std::string_view key);

    std::vector<Dictionary::Entry>& _entries;
    std::size_t _written = 0; // entries, from the front
    std::uint64_t _seen = 0; // marks of the keys so far, once one took no earlier place
};

/// The same for a list.
class ListRewriting {
public:
    explicit ListRewriting(List& list)
        : _elements(list._elements)
    {
    }

    Value& slot()
    {
        if (_written == _elements.size())
            _elements.emplace_back();
        return _elements[_written++];
    }
    void finish()
    {
        _elements.resize(_written);
    }

private:
    std::vector<Value>& _elements;
    std::size_t _written = 0;
};

/// Makes the value a dictionary, a list that may be written anew: the one that it is when nobody else holds it.
Dictionary& dictionaryToRewrite(Value& value);
List& listToRewrite(Value& value);

} // namespace spectrel
