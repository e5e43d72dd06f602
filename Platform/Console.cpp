#include "Platform/Console.h"

#include <cstdio>

namespace spectrel {

namespace {

class NoConsole final : public Console {
public:
    void line(std::string_view) override { }
};

NoConsole noConsole;

} // namespace

Console& Console::none()
{
    return noConsole;
}

void StandardErrorConsole::line(std::string_view text)
{
    std::fprintf(stderr, "%.*s\n", static_cast<int>(text.size()), text.data());
}

void StandardOutputConsole::line(std::string_view text)
{
    std::fprintf(stdout, "%.*s\n", static_cast<int>(text.size()), text.data());
    std::fflush(stdout);
}

} // namespace spectrel
