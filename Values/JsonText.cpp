#include "Values/JsonText.h"

#include <rapidjson/writer.h>

namespace spectrel {

namespace {

/// Lets RapidJSON's writer append to a string.
class StringSink {
public:
    using Ch = char;
    explicit StringSink(std::string& out)
        : _out(out)
    {
    }
    void Put(char character)
    {
        _out += character;
    }
    void Flush() { }

private:
    std::string& _out;
};

/// Whether JSON writes every character as it is. Looks at all of them, so that the machine looks at many at once.
bool isPlain(std::string_view text)
{
    unsigned special = 0;
    for (const char character : text) {
        const auto byte = static_cast<unsigned char>(character);
        special |= unsigned(byte < ' ') | unsigned(byte == '"') | unsigned(byte == '\\');
    }
    return special == 0;
}

/// RapidJSON's writer writes texts alone. It would write containers, too, but never with the blanks that the lines of
/// numbered displays and of changes have, and to begin one it adds to a null pointer (its stack of levels, which has no
/// memory before the first), where the undefined-behaviour sanitizer stops.
void appendEscaped(std::string_view text, std::string& out)
{
    StringSink sink(out);
    rapidjson::Writer<StringSink> writer(sink);
    writer.String(text.data(), static_cast<rapidjson::SizeType>(text.size()));
}

} // namespace

void appendJsonText(std::string_view text, std::string& out)
{
    if (!isPlain(text))
        return appendEscaped(text, out);
    out += '"';
    out += text;
    out += '"';
}

} // namespace spectrel
