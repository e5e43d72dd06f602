#include "Monitor/PathChoice.h"

#include <algorithm>

namespace spectrel {

PathChoice::PathChoice(const std::vector<std::string>& globs)
{
    for (const std::string& glob : globs)
        append(glob);
}

void PathChoice::append(std::string_view glob)
{
    _starts.push_back(_tokens.size());
    if (!glob.starts_with('/') && !glob.starts_with("**"))
        _tokens.push_back({Kind::Slash});
    for (std::size_t at = 0; at < glob.size(); ++at) {
        if (glob[at] == '/') {
            _tokens.push_back({Kind::Slash});
        } else if (glob[at] != '*') {
            _tokens.push_back({Kind::Character, glob[at]});
        } else if (glob.substr(at, 2) != "**") {
            _tokens.push_back({Kind::WithinName});
        } else {
            const bool isBetween = at > 0 && glob[at - 1] == '/' && glob.substr(at + 2).starts_with('/');
            _tokens.push_back({isBetween ? Kind::NoOrMoreNames : Kind::AcrossNames});
            ++at;
        }
    }
    _tokens.push_back({Kind::End});
}

PathChoice::Position PathChoice::root() const
{
    Position position(_tokens.size());
    for (const std::size_t start : _starts)
        enter(position, start);
    return position;
}

/// Comes to a token, and to those behind it where it may stand for nothing.
void PathChoice::enter(Position& position, std::size_t token) const
{
    for (;; ++token) {
        position[token] = true;
        const Kind kind = _tokens[token].kind;
        if (kind == Kind::NoOrMoreNames)
            enter(position, token + 2); // no name, and so no slash behind it
        if (!isWild(kind))
            return;
    }
}

/// As paths are joined: by one slash, whatever slashes a name begins with; a name without any text adds nothing.
PathChoice::Position PathChoice::below(const Position& parent, std::string_view name) const
{
    name.remove_prefix(std::min(name.find_first_not_of('/'), name.size()));
    if (takesAll() || name.empty())
        return parent;
    Position position = after(parent, {true});
    for (const char character : name) {
        if (!reaches(position))
            break;
        position = after(position, {false, character});
    }
    return position;
}

PathChoice::Position PathChoice::after(const Position& position, Symbol symbol) const
{
    Position next(_tokens.size());
    for (std::size_t token = 0; token < _tokens.size(); ++token) {
        if (!position[token] || !matches(_tokens[token], symbol))
            continue;
        if (isWild(_tokens[token].kind))
            next[token] = true; // and goes on
        enter(next, token + 1);
    }
    return next;
}

bool PathChoice::isWild(Kind kind)
{
    return kind == Kind::WithinName || kind == Kind::AcrossNames || kind == Kind::NoOrMoreNames;
}

bool PathChoice::matches(Token token, Symbol symbol)
{
    switch (token.kind) {
    case Kind::Character:
        return !symbol.isSeparator && symbol.character == token.character;
    case Kind::Slash:
        return symbol.isSeparator || symbol.character == '/';
    case Kind::WithinName:
        return !symbol.isSeparator;
    case Kind::AcrossNames:
    case Kind::NoOrMoreNames:
        return true;
    case Kind::End:
        break;
    }
    return false;
}

bool PathChoice::takesLeaf(const Position& position) const
{
    if (takesAll())
        return true;
    for (std::size_t token = 0; token < _tokens.size(); ++token) {
        if (position[token] && _tokens[token].kind == Kind::End)
            return true;
    }
    return false;
}

bool PathChoice::reaches(const Position& position) const
{
    return takesAll() || std::ranges::find(position, true) != position.end();
}

} // namespace spectrel
