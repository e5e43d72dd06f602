#pragma once

#include <optional>
#include <string>
#include <string_view>
#include <utility>
#include <variant>
#include <vector>

namespace spectrel {

/// The numbers and texts of one JSON object, such as a line of a JSON Lines file. Anything else in it is passed over.
class JsonObject {
public:
    /// None for what is no JSON object of well-formed UTF-8, or holds more than 16 containers within each other.
    static std::optional<JsonObject> parse(std::string text);

    /// Of a member that is there and is a number; of several the last.
    std::optional<double> number(std::string_view key) const;
    /// Of a member that is there and is a text; null otherwise.
    const std::string* text(std::string_view key) const;

private:
    class Reading;
    using Member = std::pair<std::string, std::variant<double, std::string>>;

    const Member* member(std::string_view key) const;

    std::vector<Member> _members;
};

} // namespace spectrel
