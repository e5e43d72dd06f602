#pragma once

#include "Values/Bytes.h"

#include <cstdint>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <utility>
#include <variant>

namespace spectrel {

class Dictionary;
class List;

/// Dictionaries and lists are shared by reference: a section writes into the very node that the display holds.
using DictionaryRef = std::shared_ptr<Dictionary>;
using ListRef = std::shared_ptr<List>;

/// A whole number of a property list: -2^63 to 2^64-1.
class Integer {
public:
    constexpr Integer() = default;
    static constexpr Integer fromSigned(std::int64_t value)
    {
        return {static_cast<std::uint64_t>(value), value < 0};
    }
    static constexpr Integer fromUnsigned(std::uint64_t value)
    {
        return {value, false};
    }

    constexpr bool isNegative() const
    {
        return _negative;
    }
    /// Two's complement; read as signed when `isNegative`, as unsigned otherwise.
    constexpr std::uint64_t bits() const
    {
        return _bits;
    }
    friend constexpr bool operator==(Integer, Integer) = default;

private:
    constexpr Integer(std::uint64_t bits, bool negative)
        : _bits(bits)
        , _negative(negative)
    {
    }

    std::uint64_t _bits = 0;
    bool _negative = false;
};

/// A moment of a property list: seconds since 2001-01-01 00:00 UTC, the form's own origin.
struct Date {
    double secondsSince2001 = 0;
    friend bool operator==(Date, Date) = default;
};

enum class Kind : std::uint8_t { Absent, String, Dictionary, List, Integer, Real, Boolean, Date, Data };

/// The one value type of templates, display, state, property lists and snapshots.
///
/// A value owns strings and numbers and shares containers and data. A default-made value is absent.
class Value {
public:
    Value() = default;
    Value(std::string text)
        : _held(std::move(text))
    {
    }
    Value(std::string_view text)
        : _held(std::in_place_type<std::string>, text)
    {
    }
    Value(const char* text)
        : Value(std::string_view(text))
    {
    }
    /// An absent reference makes an absent value.
    Value(DictionaryRef dictionary);
    Value(ListRef list);
    Value(DataRef data);
    Value(Date date)
        : _held(date)
    {
    }
    Value(Integer number)
        : _held(number)
    {
    }
    static Value integer(std::int64_t number)
    {
        return Integer::fromSigned(number);
    }
    static Value real(double number);
    static Value boolean(bool truth);

    Kind kind() const
    {
        return static_cast<Kind>(_held.index());
    }
    bool isAbsent() const
    {
        return kind() == Kind::Absent;
    }

    /// Each answers nothing (null, none) when the value is of another kind.
    const std::string* string() const
    {
        return std::get_if<std::string>(&_held);
    }
    const DictionaryRef& dictionary() const;
    const ListRef& list() const;
    const DataRef& data() const;
    std::optional<Integer> integer() const;
    std::optional<double> real() const;
    std::optional<bool> boolean() const;
    std::optional<Date> date() const;

    /// A number, whole by nature or by value, in the signed 32-bit range; nothing else reads as one.
    std::optional<std::int32_t> int32() const;

    /// Makes this value the text; keeps the memory of a text that was there, and does nothing for an equal one.
    void assignText(std::string_view text);

    /// Equal kind and content, containers compared deeply and dictionaries without regard to order.
    /// An integer and a real are never equal.
    friend bool operator==(const Value& left, const Value& right);

private:
    std::variant<std::monostate, std::string, DictionaryRef, ListRef, Integer, double, bool, Date, DataRef> _held;
};

} // namespace spectrel
