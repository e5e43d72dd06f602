#pragma once

#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

namespace spectrel {

/// Which leaves of the display tree somebody asked for: all of them, or those whose paths match one of several globs.
///
/// In a glob `*` stands for any text within one name, `**` for any text across names, "/**/" also for "/" alone;
/// everything else stands for itself. A glob without its leading slash is read as if it had one. A name that holds a
/// slash itself is matched as one name by `*`, and by its text.
///
/// A tree is walked from the root down, each node with its position, so that a node's own name is looked at once and a
/// branch that leads nowhere is left at its beginning. A step costs the length of the name times that of the globs,
/// whatever they are.
class PathChoice {
public:
    /// How far a node's path has got in the globs.
    using Position = std::vector<bool>;

    /// Takes every leaf.
    PathChoice() = default;
    explicit PathChoice(const std::vector<std::string>& globs);

    bool takesAll() const
    {
        return _tokens.empty();
    }
    Position root() const;
    /// Of a child under its displayed name.
    Position below(const Position& parent, std::string_view name) const;
    /// Whether a leaf here is chosen. A display that is itself a leaf has no path that a glob could match.
    bool takesLeaf(const Position& position) const;
    /// Whether a leaf here or further below could be chosen.
    bool reaches(const Position& position) const;

private:
    enum class Kind : std::uint8_t {
        Character,
        Slash, // between two names, or in one
        WithinName, // *
        AcrossNames, // **
        NoOrMoreNames, // ** between two slashes
        End,
    };
    struct Token {
        Kind kind;
        char character = '\0';
    };
    /// What a path is made of: a name's characters, and what separates names.
    struct Symbol {
        bool isSeparator;
        char character = '\0';
    };

    void append(std::string_view glob);
    void enter(Position& position, std::size_t token) const;
    Position after(const Position& position, Symbol symbol) const;
    static bool isWild(Kind kind);
    static bool matches(Token token, Symbol symbol);

    std::vector<Token> _tokens; // of one glob after the other, each with its end
    std::vector<std::size_t> _starts;
};

} // namespace spectrel
