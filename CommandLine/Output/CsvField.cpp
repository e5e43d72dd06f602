#include "CommandLine/Output/CsvField.h"

namespace spectrel {

namespace {

/// Whether the field holds nothing that must be quoted. Looks at all of it, so that the machine looks at many at once.
bool isPlain(std::string_view field)
{
    unsigned special = 0;
    for (const char character : field)
        special |= unsigned(character == ',') | unsigned(character == '"') | unsigned(character == '\r')
            | unsigned(character == '\n');
    return special == 0;
}

} // namespace

void appendCsvField(std::string_view field, std::string& out)
{
    if (isPlain(field)) {
        out += field;
        return;
    }
    out += '"';
    for (const char character : field) {
        if (character == '"')
            out += '"';
        out += character;
    }
    out += '"';
}

} // namespace spectrel
