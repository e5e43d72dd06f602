#pragma once

#include "Values/ContainerObserver.h"
#include "Values/Value.h"

#include <cstddef>
#include <initializer_list>
#include <memory>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

namespace spectrel {

/// A string-keyed dictionary in insertion order.
///
/// Overwriting a key keeps its place; removing and storing again appends. A search starts where the last one ended, so
/// that keys taken in their order are found at the first try; large dictionaries keep a sorted index beside.
class Dictionary {
public:
    struct Entry {
        std::string key;
        Value value;
    };

    Dictionary();
    Dictionary(std::initializer_list<Entry> entries);
    Dictionary(const Dictionary&) = delete;
    Dictionary& operator=(const Dictionary&) = delete;
    ~Dictionary();

    static DictionaryRef make(std::initializer_list<Entry> entries = {});

    std::size_t count() const
    {
        return _entries.size();
    }
    const std::vector<Entry>& entries() const
    {
        return _entries;
    }

    /// The value under the key; an absent value when there is none.
    const Value& operator[](std::string_view key) const;
    bool contains(std::string_view key) const;

    /// Stores the value; an absent value removes the key.
    void set(std::string_view key, Value value);
    /// Stores a text; when the key holds a text already, its memory is used again.
    void setText(std::string_view key, std::string_view text);
    void remove(std::string_view key);
    void removeAll();
    /// Makes room for so many entries.
    void reserve(std::size_t count)
    {
        _entries.reserve(count);
    }

    /// A new dictionary with the same entries and no observer; containers inside stay shared.
    DictionaryRef copy() const;

    /// At most one observer; null takes it away.
    void setObserver(std::unique_ptr<ContainerObserver> observer)
    {
        _observer = std::move(observer);
    }
    ContainerObserver* observer() const
    {
        return _observer.get();
    }

private:
    friend class DictionaryRewriting;
    struct Index;

    std::vector<Entry>& entriesToRewrite();
    std::size_t positionOf(std::string_view key) const;
    std::size_t append(std::string_view key, Value value);

    std::vector<Entry> _entries;
    std::unique_ptr<ContainerObserver> _observer;
    mutable std::size_t _next = 0; // where the next search starts
    mutable std::unique_ptr<Index> _index; // positions in key order, only while large
};

/// A container with the same top level, what is inside staying shared; any other value as it is.
Value copyTopLevel(const Value& value);

} // namespace spectrel
