#include "Platform/Console.h"

#include "Platform/ErrorOutput.h"

#include <cstdio>

namespace spectrel {

namespace {
Console* installedConsole = nullptr;
}

void Console::install(Console* console)
{
    installedConsole = console;
}

Console* Console::installed()
{
    return installedConsole;
}

void consoleLine(std::string_view text)
{
    if (installedConsole)
        installedConsole->line(text);
}

void StandardErrorConsole::line(std::string_view text)
{
    writeErrorLine("", text);
}

void StandardOutputConsole::line(std::string_view text)
{
    std::fprintf(stdout, "%.*s\n", static_cast<int>(text.size()), text.data());
    std::fflush(stdout);
}

} // namespace spectrel
