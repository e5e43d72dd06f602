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

} // namespace

/// RapidJSON's writer writes texts alone. It would write containers, too, but never with the blanks that the lines of
/// numbered displays and of changes have, and to begin one it adds to a null pointer (its stack of levels, which has no
/// memory before the first), where the undefined-behaviour sanitizer stops.
void appendJsonText(std::string_view text, std::string& out)
{
    StringSink sink(out);
    rapidjson::Writer<StringSink> writer(sink);
    writer.String(text.data(), static_cast<rapidjson::SizeType>(text.size()));
}

} // namespace spectrel
