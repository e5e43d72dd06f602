#include "CommandLine/Output/DisplayPrinter.h"

#include "CommandLine/Output/JsonText.h"
#include "Monitor/DisplayOrder.h"
#include "Monitor/SpectrelModelNode.h"
#include "Monitor/TreeText.h"
#include "Values/List.h"

#include <utility>

namespace spectrel {

namespace {

/// Appends a child's separator, and so begins every child but the first.
void separate(bool& isFirst, std::string& out)
{
    if (!std::exchange(isFirst, false))
        out += ',';
}

void appendNode(std::string_view name, const Value& value, std::size_t depth, std::string& out);

void appendChildren(const Value& value, std::size_t depth, std::string& out)
{
    if (const auto& dictionary = value.dictionary()) {
        forEachDisplayChild(
            *dictionary, [&](std::string_view name, const Value& child) { appendNode(name, child, depth, out); });
    } else if (const auto& list = value.list()) {
        std::size_t position = 0;
        for (const Value& element : list->elements())
            appendNode(std::to_string(position++), element, depth, out);
    }
}

void appendNode(std::string_view name, const Value& value, std::size_t depth, std::string& out)
{
    if (value.dictionary() || value.list()) {
        appendTreeLine(name, nullptr, depth, out);
        return appendChildren(value, depth + 1, out);
    }
    const std::string_view text = value.string() ? std::string_view(*value.string()) : UnknownText;
    appendTreeLine(name, &text, depth, out);
}

} // namespace

void appendTree(const Value& display, std::string& out)
{
    if (display.dictionary() || display.list())
        return appendChildren(display, 0, out);
    appendPlain(display.string() ? std::string_view(*display.string()) : UnknownText, out);
    out += '\n';
}

void appendJson(const Value& display, std::string& out)
{
    bool isFirst = true;
    if (const auto& dictionary = display.dictionary()) {
        out += '{';
        forEachDisplayChild(*dictionary, [&](std::string_view name, const Value& child) {
            separate(isFirst, out);
            appendJsonText(name, out);
            out += ':';
            appendJson(child, out);
        });
        out += '}';
    } else if (const auto& list = display.list()) {
        out += '[';
        for (const Value& element : list->elements()) {
            separate(isFirst, out);
            appendJson(element, out);
        }
        out += ']';
    } else {
        appendJsonText(display.string() ? std::string_view(*display.string()) : UnknownText, out);
    }
}

} // namespace spectrel
