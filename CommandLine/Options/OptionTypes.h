#pragma once

#include "Records/Recording.h"

#include <CLI/CLI.hpp>
#include <chrono>
#include <cstdint>
#include <limits>
#include <optional>
#include <string>
#include <string_view>

namespace spectrel {

/// A time span such as "30s", "5m", "2h", "500ms"; a number alone counts seconds. None for anything else.
std::optional<std::chrono::milliseconds> parseDuration(std::string_view text);

/// The same, or no time at all, such as "0s".
std::optional<std::chrono::milliseconds> parseOffset(std::string_view text);

/// A number of bytes such as "500k", "100M", "2G" (powers of 1000); a number alone counts bytes. At least one kilobyte;
/// none for anything else.
std::optional<std::uint64_t> parseSize(std::string_view text);

/// A whole number, in digits alone, within the bounds; none for anything else.
std::optional<std::uint64_t> parseWholeNumber(std::string_view text, std::uint64_t least, std::uint64_t largest);

/// A finite number such as "2", "0.5" or "1e3", within the bounds; none for anything else.
std::optional<double> parseNumber(std::string_view text, double least, double largest);

/// How the value of an option is written.
template <typename Value> struct OptionForm {
    const char* typeName; // in the help
    std::optional<Value> (*parse)(std::string_view text); // none for a text of another form
    const char* complaint; // about such a text, which stands before it in quotes
};

/// What the options of several programs accept.
extern const OptionForm<Technology> TechnologyForm;
extern const OptionForm<std::chrono::milliseconds> DurationForm;
extern const OptionForm<std::uint64_t> SizeForm;
extern const OptionForm<std::uint64_t> CountForm; // from 1 up
extern const OptionForm<std::string> FileForm; // a name, which is not empty
extern const OptionForm<std::string> FolderForm;

/// Adds an option whose value is written in a form of its own.
template <typename Value, typename Target>
CLI::Option* addFormedOption(CLI::App& command, const std::string& name, Target& target, const OptionForm<Value>& form,
    const std::string& description)
{
    const auto take = [name, &target, form](const std::string& text) {
        const auto value = form.parse(text);
        if (!value)
            throw CLI::ValidationError(name, "'" + text + "' " + form.complaint);
        target = *value;
    };
    return command.add_option_function<std::string>(name, take, description)->type_name(form.typeName);
}

} // namespace spectrel
