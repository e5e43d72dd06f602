#include "UI/Terminal/LineEditor.h"

#include "Values/UTF8.h"

#include <algorithm>

namespace spectrel {

namespace {

/// The end of the glyph that begins at the place; the text's end there.
std::size_t glyphEnd(std::string_view text, std::size_t place)
{
    std::string_view rest = text.substr(place);
    const auto glyph = takeGlyph(rest);
    return glyph ? place + glyph->bytes : text.size();
}

/// The beginning of the last glyph before the place.
std::size_t glyphBefore(std::string_view text, std::size_t place)
{
    std::size_t start = 0;
    for (std::size_t end = glyphEnd(text, start); end < place; end = glyphEnd(text, start))
        start = end;
    return start;
}

/// The beginning of the word that ends at the place, blanks behind it included.
std::size_t wordBefore(std::string_view text, std::size_t place)
{
    while (place > 0 && text[place - 1] == ' ')
        --place;
    while (place > 0 && text[place - 1] != ' ')
        --place;
    return place;
}

} // namespace

/// The cursor's place, at the beginning of a glyph also when the text was changed by others.
std::size_t LineEditor::cursorIn(std::string_view text) const
{
    if (_cursor >= text.size())
        return text.size();
    std::size_t place = 0;
    while (place < _cursor) {
        const std::size_t next = glyphEnd(text, place);
        if (next > _cursor)
            break;
        place = next;
    }
    return place;
}

void LineEditor::erase(std::string& text, std::size_t from, std::size_t end)
{
    text.erase(from, end - from);
    _cursor = from;
}

bool LineEditor::handle(const KeyEvent& event, std::string& text, std::size_t maximum)
{
    _cursor = cursorIn(text);
    switch (event.key) {
    case Key::Character: {
        std::string typed;
        appendUTF8(typed, event.character);
        if (text.size() + typed.size() <= maximum) {
            text.insert(_cursor, typed);
            _cursor += typed.size();
        }
        return true;
    }
    case Key::Left:
        _cursor = glyphBefore(text, _cursor);
        return true;
    case Key::Right:
        _cursor = glyphEnd(text, _cursor);
        return true;
    case Key::Home:
        _cursor = 0;
        return true;
    case Key::End:
        _cursor = text.size();
        return true;
    case Key::Backspace:
        erase(text, glyphBefore(text, _cursor), _cursor);
        return true;
    case Key::Delete:
        erase(text, _cursor, glyphEnd(text, _cursor));
        return true;
    case Key::EraseWord:
        erase(text, wordBefore(text, _cursor), _cursor);
        return true;
    case Key::ClearLine:
        erase(text, 0, text.size());
        return true;
    default:
        return false;
    }
}

void LineEditor::draw(Grid& grid, int y, Span place, std::string_view text, bool showsCursor) const
{
    const std::size_t cursor = cursorIn(text);
    const int before = columnsOf(text.substr(0, cursor));
    const int room = place.right - place.left - 1; // the cursor may stand behind the text
    const int start = place.left - std::max(0, before - room);
    grid.put(start, y, text, Style {}, place);
    if (showsCursor) {
        const int columns = cursor < text.size() ? columnsOf(text.substr(cursor, glyphEnd(text, cursor) - cursor)) : 1;
        grid.reverse(y, {start + before, std::min(start + before + columns, place.right)});
    }
}

} // namespace spectrel
