#include "Records/Beside/Marks.h"

#include "Records/Beside/Beside.h"
#include "Values/JsonText.h"
#include "Values/UTF8.h"

#include <algorithm>
#include <cstdint>
#include <string_view>

namespace spectrel {

namespace {

/// Well-formed text of at most the longest note.
std::string noteText(std::string_view note)
{
    std::string text;
    while (!note.empty()) {
        const auto character = decodeUTF8(note);
        std::string next;
        appendUTF8(next, character ? character->character : ReplacementCharacter);
        if (text.size() + next.size() > LongestNote)
            break;
        text += next;
        note.remove_prefix(character ? character->bytes : 1);
    }
    return text;
}

} // namespace

std::string marksPath(const std::string& recording)
{
    return pathBeside(recording, MarksEnding);
}

Marks readMarks(const std::string& recording)
{
    Marks read;
    read.damage = readBeside(marksPath(recording), [&read](const JsonObject& object) {
        const auto time = timeOf(object);
        const std::string* const note = object.text("note");
        if (time && note)
            read.marks.push_back({*time, *note});
        return time && note;
    });
    std::ranges::stable_sort(read.marks, {}, &Mark::time);
    return read;
}

Outcome appendMark(const std::string& recording, const Mark& mark)
{
    std::string line = "{\"time\": " + secondsForm(mark.time) + ", \"note\": ";
    appendJsonText(noteText(mark.note), line);
    return appendBeside(marksPath(recording), line + "}");
}

} // namespace spectrel
