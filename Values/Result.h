#pragma once

#include <cerrno>
#include <concepts>
#include <cstdint>
#include <string>
#include <type_traits>
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

    /// Of a system call, in the C library's words.
    static Failure ofSystem(int error = errno);
    /// The same failure, its text led in by what failed: "FILE: No such file or directory".
    Failure of(const std::string& what) const
    {
        return {what + ": " + text, code};
    }

    std::string text; // for people, without the name of the file or program, which the caller knows
    Code code = Code::Failed;
};

/// What an operation that can fail yields: the value, or why there is none.
///
///     auto reader = openRecording(path);
///     if (!reader)
///         return reader.failure();
template <typename Value> class [[nodiscard]] Result {
public:
    /// From whatever a value is made of, such as a pointer to a derived class; its constraint keeps copies out.
    // NOLINTBEGIN(bugprone-forwarding-reference-overload)
    template <typename Source = Value>
    requires std::convertible_to<Source, Value> &&(!std::same_as<std::remove_cvref_t<Source>, Result>)&&(
        !std::same_as<std::remove_cvref_t<Source>, Failure>)Result(Source&& value)
        : _held(std::in_place_index<0>, std::forward<Source>(value))
    {
    }
    // NOLINTEND(bugprone-forwarding-reference-overload)
    Result(Failure failure)
        : _held(std::in_place_index<1>, std::move(failure))
    {
    }

    explicit operator bool() const
    {
        return _held.index() == 0;
    }
    /// Only of a result with a value, as the arrow.
    Value& operator*() &
    {
        return *std::get_if<0>(&_held);
    }
    const Value& operator*() const&
    {
        return *std::get_if<0>(&_held);
    }
    Value operator*() &&
    {
        return std::move(*std::get_if<0>(&_held));
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
