#pragma once

#include <cstdint>
#include <string>
#include <utility>
#include <variant>

namespace spectrel {

/// Why something could not be done.
struct Failure {
    /// What the caller may want to tell apart; everything else is `Failed`.
    enum class Code : std::uint8_t {
        Failed,
        Exists, // a file of that name is there already
        Missing, // there is none
        Refused, // it is there, but somebody else's, or not of the kind asked for
        NoRoom, // the disk, a quota or a limit of the system is exhausted
    };

    std::string text; // for people, without the name of the file or program, which the caller knows
    Code code = Code::Failed;
};

/// What an operation that can fail yields: the value, or why there is none.
template <typename Value> class [[nodiscard]] Result {
public:
    Result(Value value)
        : _held(std::in_place_index<0>, std::move(value))
    {
    }
    Result(Failure failure)
        : _held(std::in_place_index<1>, std::move(failure))
    {
    }

    explicit operator bool() const
    {
        return _held.index() == 0;
    }
    Value& operator*()
    {
        return *std::get_if<0>(&_held);
    }
    const Value& operator*() const
    {
        return *std::get_if<0>(&_held);
    }
    Value* operator->()
    {
        return std::get_if<0>(&_held);
    }
    const Value* operator->() const
    {
        return std::get_if<0>(&_held);
    }
    /// Only of a result without a value.
    const Failure& failure() const
    {
        return *std::get_if<1>(&_held);
    }

private:
    std::variant<Value, Failure> _held;
};

/// The result of an operation that yields nothing but its success.
struct Done { };
using Outcome = Result<Done>;

} // namespace spectrel
