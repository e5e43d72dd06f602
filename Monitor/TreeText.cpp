#include "Monitor/TreeText.h"

#include <cstdio>

namespace spectrel {

namespace {

void appendNode(const SpectrelModelNode& node, std::size_t depth, std::string& out)
{
    const NodeList* children = node.childNodes();
    if (!children) {
        const std::string_view value = node.value() ? std::string_view(*node.value()) : std::string_view();
        return appendTreeLine(node.displayName(), &value, depth, out);
    }
    appendTreeLine(node.displayName(), nullptr, depth, out);
    for (const NodeRef& child : *children)
        appendNode(*child, depth + 1, out);
}

} // namespace

void appendPlain(std::string_view text, std::string& out)
{
    for (const char character : text) {
        const auto byte = static_cast<unsigned char>(character);
        if (byte >= 0x20 && byte != 0x7F) {
            out += character;
            continue;
        }
        char escaped[8];
        std::snprintf(escaped, sizeof escaped, "\\x%02x", byte);
        out += escaped;
    }
}

void appendTreeLine(std::string_view name, const std::string_view* value, std::size_t depth, std::string& out)
{
    out.append(2 * depth, ' ');
    appendPlain(name, out);
    if (value) {
        out += ": ";
        appendPlain(*value, out);
    }
    out += '\n';
}

void appendNodeText(const SpectrelModelNode& node, std::string& out)
{
    appendNode(node, 0, out);
}

void appendTreeText(const SpectrelModelNode& node, std::string& out)
{
    if (const NodeList* children = node.childNodes()) {
        for (const NodeRef& child : *children)
            appendNode(*child, 0, out);
    } else if (node.value()) {
        appendPlain(*node.value(), out);
        out += '\n';
    }
}

} // namespace spectrel
