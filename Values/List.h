#pragma once

#include "Values/ContainerObserver.h"
#include "Values/Value.h"

#include <cstddef>
#include <initializer_list>
#include <memory>
#include <utility>
#include <vector>

namespace spectrel {

/// An ordered list of values.
class List {
public:
    List() = default;
    List(std::initializer_list<Value> elements)
        : _elements(elements)
    {
    }
    List(const List&) = delete;
    List& operator=(const List&) = delete;

    static ListRef make(std::initializer_list<Value> elements = {});

    std::size_t count() const
    {
        return _elements.size();
    }
    const std::vector<Value>& elements() const
    {
        return _elements;
    }
    const Value& operator[](std::size_t position) const
    {
        return _elements[position];
    }

    /// An absent value is not appended.
    void append(Value value);
    /// Removes `count` elements from the front, at most all.
    void removeFirst(std::size_t count);
    void removeAll();
    /// A new list with the same elements and no observer; containers inside stay shared.
    ListRef copy() const;

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
    friend class ListRewriting;

    std::unique_ptr<ContainerObserver> _observer;
    std::vector<Value> _elements;
};

} // namespace spectrel
