#include "Values/List.h"

#include <algorithm>

namespace spectrel {

ListRef List::make(std::initializer_list<Value> elements)
{
    auto list = std::make_shared<List>();
    for (const Value& element : elements)
        list->append(element);
    return list;
}

void List::append(Value value)
{
    if (value.isAbsent())
        return;
    if (_observer)
        _observer->willAppend(count(), value);
    _elements.push_back(std::move(value));
}

void List::removeFirst(std::size_t count)
{
    if (_observer)
        _observer->willRemoveAll(_elements);
    _elements.erase(_elements.begin(), _elements.begin() + static_cast<std::ptrdiff_t>(std::min(count, this->count())));
    if (_observer) {
        for (std::size_t position = 0; position < this->count(); ++position)
            _observer->willAppend(position, _elements[position]);
    }
}

void List::removeAll()
{
    if (_observer)
        _observer->willRemoveAll(_elements);
    _elements.clear();
}

ListRef List::copy() const
{
    auto copied = make();
    copied->_elements = _elements;
    return copied;
}

} // namespace spectrel
