#include "UI/CopyController.h"

#include "Monitor/TreeText.h"
#include "UI/SpectrelPaneController.h"

#include <algorithm>

namespace spectrel {

namespace {

std::string linesOf(const std::string& text)
{
    const auto lines = std::ranges::count(text, '\n');
    return std::to_string(lines) + (lines == 1 ? " line" : " lines");
}

} // namespace

void CopyController::copyRow(const SpectrelPaneController& pane, std::size_t row)
{
    const NodeRef child = pane.childAtRow(row);
    if (!child)
        return;
    std::string text;
    if (child->childNodes()) {
        appendNodeText(*child, text);
        return copy(text, linesOf(text));
    }
    if (child->value())
        appendPlain(*child->value(), text);
    copy(text, "the value of " + child->displayName());
}

void CopyController::copyPane(const SpectrelPaneController& pane)
{
    if (!pane.node())
        return;
    std::string text;
    appendTreeText(*pane.node(), text);
    copy(text, linesOf(text));
}

void CopyController::copy(const std::string& text, const std::string& what)
{
    const Outcome copied = _toolkit.copyToClipboard(text);
    _message = copied ? "Copied " + what : "Not copied: " + copied.failure().text;
    _toolkit.screenDidChange(ScreenPart::Notice, Animation::Animated);
}

void CopyController::clearMessage()
{
    if (_message.empty())
        return;
    _message.clear();
    _toolkit.screenDidChange(ScreenPart::Notice, Animation::Animated);
}

} // namespace spectrel
