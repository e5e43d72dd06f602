#include "Values/Value.h"

#include "Values/Dictionary.h"
#include "Values/List.h"

#include <algorithm>
#include <cmath>
#include <limits>

namespace spectrel {

namespace {

const DictionaryRef NoDictionary;
const ListRef NoList;
const DataRef NoData;

bool equal(const Dictionary& left, const Dictionary& right)
{
    return left.count() == right.count()
        && std::ranges::all_of(left.entries(), [&](const auto& entry) { return right[entry.key] == entry.value; });
}

} // namespace

Value::Value(DictionaryRef dictionary)
{
    if (dictionary)
        _held = std::move(dictionary);
}

Value::Value(ListRef list)
{
    if (list)
        _held = std::move(list);
}

Value::Value(DataRef data)
{
    if (data)
        _held = std::move(data);
}

Value Value::real(double number)
{
    Value value;
    value._held = number;
    return value;
}

Value Value::boolean(bool truth)
{
    Value value;
    value._held = truth;
    return value;
}

const DictionaryRef& Value::dictionary() const
{
    const auto* held = std::get_if<DictionaryRef>(&_held);
    return held ? *held : NoDictionary;
}

const ListRef& Value::list() const
{
    const auto* held = std::get_if<ListRef>(&_held);
    return held ? *held : NoList;
}

const DataRef& Value::data() const
{
    const auto* held = std::get_if<DataRef>(&_held);
    return held ? *held : NoData;
}

std::optional<Integer> Value::integer() const
{
    const auto* held = std::get_if<Integer>(&_held);
    return held ? std::optional(*held) : std::nullopt;
}

std::optional<double> Value::real() const
{
    const auto* held = std::get_if<double>(&_held);
    return held ? std::optional(*held) : std::nullopt;
}

std::optional<bool> Value::boolean() const
{
    const auto* held = std::get_if<bool>(&_held);
    return held ? std::optional(*held) : std::nullopt;
}

std::optional<Date> Value::date() const
{
    const auto* held = std::get_if<Date>(&_held);
    return held ? std::optional(*held) : std::nullopt;
}

std::optional<std::int32_t> Value::int32() const
{
    using Limits = std::numeric_limits<std::int32_t>;
    if (const auto number = integer()) {
        const auto magnitude = static_cast<std::int64_t>(number->bits());
        if (number->isNegative() != (magnitude < 0) || magnitude < Limits::min() || magnitude > Limits::max())
            return std::nullopt;
        return static_cast<std::int32_t>(magnitude);
    }
    if (const auto number = real()) {
        if (!(*number >= Limits::min() && *number <= Limits::max()) || std::trunc(*number) != *number)
            return std::nullopt;
        return static_cast<std::int32_t>(*number);
    }
    return std::nullopt;
}

void Value::assignText(std::string_view text)
{
    auto* held = std::get_if<std::string>(&_held);
    if (!held)
        _held.emplace<std::string>(text);
    else if (*held != text)
        held->assign(text);
}

bool operator==(const Value& left, const Value& right)
{
    if (left.kind() != right.kind())
        return false;
    switch (left.kind()) {
    case Kind::Dictionary:
        return left.dictionary() == right.dictionary() || equal(*left.dictionary(), *right.dictionary());
    case Kind::List:
        return left.list() == right.list() || left.list()->elements() == right.list()->elements();
    case Kind::Data:
        return *left.data() == *right.data();
    default:
        return left._held == right._held;
    }
}

} // namespace spectrel
