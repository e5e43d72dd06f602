#include "CommandLine/Output/CsvField.h"

namespace spectrel {

void appendCsvField(std::string_view field, std::string& out)
{
    if (field.find_first_of(",\"\r\n") == std::string_view::npos) {
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
