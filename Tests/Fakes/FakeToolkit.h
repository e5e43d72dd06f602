#pragma once

#include "UI/ScreenToolkit.h"

#include <map>
#include <string>
#include <string_view>
#include <vector>

namespace spectrel {

/// A toolkit without a screen: every character is 10 pt wide unless told otherwise.
class FakeToolkit final : public ScreenToolkit {
public:
    Size sizeOfText(std::string_view text, const Font& font) const override
    {
        measuredFonts.push_back(font);
        const auto found = sizes.find(text);
        return found == sizes.end() ? Size {10.0 * static_cast<double>(text.size()), 18} : found->second;
    }
    Size mainScreenSize() const override
    {
        return {320, 480};
    }
    void screenDidChange(ScreenPart part, Animation animation) override
    {
        changes.push_back({part, animation});
    }
    void showAlert(const Alert& alert) override
    {
        alerts.push_back(alert);
    }

    Outcome copyToClipboard(const std::string& text) override
    {
        if (!refusesToCopy.empty())
            return Failure {refusesToCopy};
        clipboard = text;
        return Done {};
    }

    struct Change {
        ScreenPart part;
        Animation animation;
        friend bool operator==(const Change&, const Change&) = default;
    };
    std::map<std::string, Size, std::less<>> sizes;
    std::vector<Change> changes;
    std::vector<Alert> alerts;
    std::string clipboard;
    std::string refusesToCopy; // why copying fails; empty: it does not
    mutable std::vector<Font> measuredFonts;
};

} // namespace spectrel
