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
    if (!value.isAbsent())
        _elements.push_back(std::move(value));
}

void List::removeFirst(std::size_t count)
{
    _elements.erase(_elements.begin(), _elements.begin() + static_cast<std::ptrdiff_t>(std::min(count, this->count())));
}

ListRef List::copy() const
{
    auto copied = make();
    copied->_elements = _elements;
    return copied;
}

} // namespace spectrel
