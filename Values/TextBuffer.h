#pragma once

#include <cstddef>
#include <cstdint>
#include <string_view>

namespace spectrel {

/// A short display text being made in place: printf's formats, to the character, in the C locale and without its cost.
class TextBuffer {
public:
    /// "%d".
    TextBuffer& decimal(std::int64_t number);
    /// "%4.2f": at least four characters, two decimals; a not-a-number is " nan", never with a sign.
    TextBuffer& fixed2(double number);
    /// "%f": six decimals; a not-a-number is "nan", never with a sign.
    TextBuffer& fixed6(double number);
    /// Further text; what does not fit the buffer is cut.
    TextBuffer& text(std::string_view text);

    void clear()
    {
        _length = 0;
    }
    std::string_view view() const
    {
        return {_characters, _length};
    }

private:
    TextBuffer& fixed(double number, std::size_t leastLength, int decimals);

    char _characters[400]; // a double in full, and a unit
    std::size_t _length = 0;
};

} // namespace spectrel
