#include "CommandLine/Output/DisplayPrinter.h"

#include "Monitor/DisplayOrder.h"
#include "Monitor/SpectrelModelNode.h"
#include "Monitor/TreeText.h"
#include "Values/JsonText.h"
#include "Values/List.h"

#include <cstddef>
#include <string_view>

namespace spectrel {

namespace {

/// One display being printed. Each operation answers whether it has printed anything that was chosen; what it has
/// printed in vain is taken back by its caller.
class DisplayPrinter {
public:
    DisplayPrinter(std::string& out, const PathChoice& paths)
        : _out(out)
        , _paths(paths)
    {
    }

    bool printTree(const Value& container, std::size_t depth, const PathChoice::Position& position)
    {
        bool hasPrinted = _paths.takesAll();
        forEachChild(container, position, [&](std::string_view name, const Value& child, const auto& below) {
            hasPrinted = printTreeNode(name, child, depth, below) || hasPrinted;
        });
        return hasPrinted;
    }
    bool printJson(const Value& value, const PathChoice::Position& position)
    {
        if (value.dictionary() || value.list())
            return printJsonContainer(value, position);
        appendJsonText(value.string() ? std::string_view(*value.string()) : UnknownText, _out);
        return _paths.takesLeaf(position);
    }

private:
    /// Leaves out the children in which nothing can be chosen.
    template <typename Visit>
    void forEachChild(const Value& container, const PathChoice::Position& position, Visit visit) const
    {
        const auto visitIfReached = [&](std::string_view name, const Value& child) {
            if (const auto below = _paths.below(position, name); _paths.reaches(below))
                visit(name, child, below);
        };
        if (const auto& dictionary = container.dictionary())
            return forEachDisplayChild(*dictionary, visitIfReached);
        std::size_t index = 0;
        for (const Value& element : container.list()->elements())
            visitIfReached(std::to_string(index++), element);
    }

    bool printTreeNode(
        std::string_view name, const Value& value, std::size_t depth, const PathChoice::Position& position)
    {
        const std::size_t before = _out.size();
        if (value.dictionary() || value.list()) {
            appendTreeLine(name, nullptr, depth, _out);
            if (printTree(value, depth + 1, position))
                return true;
            _out.resize(before);
            return false;
        }
        const std::string_view text = value.string() ? std::string_view(*value.string()) : UnknownText;
        if (_paths.takesLeaf(position))
            appendTreeLine(name, &text, depth, _out);
        return _out.size() > before;
    }

    bool printJsonContainer(const Value& container, const PathChoice::Position& position)
    {
        const bool isDictionary = container.dictionary() != nullptr;
        bool isEmpty = true;
        _out += isDictionary ? '{' : '[';
        forEachChild(container, position, [&](std::string_view name, const Value& child, const auto& below) {
            const std::size_t before = _out.size();
            if (!isEmpty)
                _out += ',';
            if (isDictionary) {
                appendJsonText(name, _out);
                _out += ':';
            }
            if (printJson(child, below))
                isEmpty = false;
            else
                _out.resize(before);
        });
        _out += isDictionary ? '}' : ']';
        return !isEmpty || _paths.takesAll();
    }

    std::string& _out;
    const PathChoice& _paths;
};

} // namespace

void appendTree(const Value& display, std::string& out, const PathChoice& paths)
{
    if (display.dictionary() || display.list()) {
        DisplayPrinter(out, paths).printTree(display, 0, paths.root());
        return;
    }
    appendPlain(display.string() ? std::string_view(*display.string()) : UnknownText, out);
    out += '\n';
}

void appendJson(const Value& display, std::string& out, const PathChoice& paths)
{
    DisplayPrinter(out, paths).printJson(display, paths.root());
}

} // namespace spectrel
