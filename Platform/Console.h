#pragma once

#include <string_view>

namespace spectrel {

/// The few lines that the system writes to standard output ("Deallocing ClassIndex", the debug lines of a section).
///
/// They go to standard output in the graphical application and to standard error in programs whose standard output is
/// their result or the screen.
class Console {
public:
    virtual ~Console() = default;
    /// `text` comes without its newline.
    virtual void line(std::string_view text) = 0;

    /// Drops the lines.
    static Console& none();
};

/// Writes to standard error, for programs whose standard output is their result.
class StandardErrorConsole : public Console {
public:
    void line(std::string_view text) override;
};

/// Writes to standard output, each line at once, for the graphical application.
class StandardOutputConsole : public Console {
public:
    void line(std::string_view text) override;
};

} // namespace spectrel
