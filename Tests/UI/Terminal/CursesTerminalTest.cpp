#include "UI/Terminal/CursesTerminal.h"
#include "UI/Terminal/SignalRelay.h"

#include <gtest/gtest.h>

#include <array>
#include <csignal>
#include <cstdio>
#include <cstdlib>
#include <functional>
#include <poll.h>
#include <pty.h>
#include <string>
#include <sys/resource.h>
#include <sys/wait.h>
#include <unistd.h>

namespace spectrel {
namespace {

struct Ended {
    std::string output; // all that reached the terminal
    int status = 0; // as waitpid says it
};

/// Runs the action in a process of its own on a terminal of 20 by 4.
Ended runOnTerminal(const char* kind, const std::function<void()>& action)
{
    winsize size {4, 20, 0, 0};
    int master = -1;
    const pid_t child = ::forkpty(&master, nullptr, nullptr, &size);
    if (child == 0) {
        const rlimit noCore {0, 0};
        ::setrlimit(RLIMIT_CORE, &noCore);
        ::setenv("TERM", kind, 1);
        ::setenv("LC_ALL", "C.UTF-8", 1);
        for (const char* name :
            {"LINES", "COLUMNS", "TERMINFO", "TERMINFO_DIRS"}) // they would speak of another terminal
            ::unsetenv(name);
        action();
        std::exit(0);
    }
    Ended outcome;
    std::array<char, 4096> bytes;
    ssize_t count = 0;
    while ((count = ::read(master, bytes.data(), bytes.size())) > 0)
        outcome.output.append(bytes.data(), static_cast<std::size_t>(count));
    ::waitpid(child, &outcome.status, 0);
    ::close(master);
    return outcome;
}

std::unique_ptr<CursesTerminal> showText(std::string_view text)
{
    auto opened = CursesTerminal::open();
    if (!opened) {
        std::printf("%s\n", opened.failure().text.c_str());
        std::exit(1);
    }
    auto terminal = std::move(*opened);
    Grid grid(terminal->width(), terminal->height());
    grid.put(0, 0, text, Style {.tint = Tint::Accent});
    terminal->show(grid);
    return terminal;
}

constexpr const char* LeavesScreen = "\033[?1049l";

/// What came after the screen was left.
std::string afterScreen(const std::string& output)
{
    const auto left = output.rfind(LeavesScreen);
    return left == std::string::npos ? "never left" : output.substr(left);
}

TEST(CursesTerminalTest, ShowsTheGridAndGivesTheTerminalBack)
{
    const Ended outcome = runOnTerminal("xterm", [] { showText("日本"); });
    EXPECT_NE(outcome.output.find("日本"), std::string::npos);
    EXPECT_NE(afterScreen(outcome.output), "never left");
    EXPECT_EQ(outcome.status, 0);
}

TEST(CursesTerminalTest, ACrashGivesTheTerminalBackAndStaysACrash)
{
    for (const int signal : {SIGSEGV, SIGABRT, SIGBUS, SIGFPE, SIGILL, SIGQUIT}) {
        const Ended outcome = runOnTerminal("xterm", [signal] {
            std::signal(signal, SIG_DFL); // whatever a sanitizer has put there
            const auto terminal = showText("text");
            ::raise(signal);
        });
        EXPECT_NE(afterScreen(outcome.output), "never left") << signal;
        ASSERT_TRUE(WIFSIGNALED(outcome.status)) << signal;
        EXPECT_EQ(WTERMSIG(outcome.status), signal);
    }
}

TEST(CursesTerminalTest, StandardErrorIsHeldUntilTheScreenIsLeft)
{
    const Ended outcome = runOnTerminal("xterm", [] {
        const auto terminal = showText("text");
        std::fprintf(stderr, "a held line\n");
    });
    EXPECT_NE(afterScreen(outcome.output).find("a held line"), std::string::npos);
    EXPECT_EQ(outcome.output.find("a held line"), outcome.output.rfind("a held line"));
}

TEST(CursesTerminalTest, CopyingSendsTheTextToTheTerminalsClipboard)
{
    const Ended outcome = runOnTerminal("xterm-256color", [] { showText("hello")->copy("20 MHz\n"); });
    const auto sent = outcome.output.find("\033]52;c;MjAgTUh6Cg==\a");
    ASSERT_NE(sent, std::string::npos);
    EXPECT_GT(sent, outcome.output.find("hello"));
}

TEST(CursesTerminalTest, ColoursAreLeftOutWhenNotWanted)
{
    const auto show = [] { showText("text"); };
    ::unsetenv("NO_COLOR");
    EXPECT_NE(runOnTerminal("xterm", show).output.find("\033[36m"), std::string::npos);
    EXPECT_EQ(runOnTerminal("vt100", show).output.find("\033[36m"), std::string::npos);
    ::setenv("NO_COLOR", "1", 1);
    EXPECT_EQ(runOnTerminal("xterm", show).output.find("\033[3"), std::string::npos);
    ::unsetenv("NO_COLOR");
}

TEST(CursesTerminalTest, AnUnknownTerminalIsRefusedWithItsName)
{
    const Ended outcome = runOnTerminal("nonsense", [] { showText("text"); });
    EXPECT_NE(outcome.output.find("\"nonsense\""), std::string::npos);
    EXPECT_EQ(WEXITSTATUS(outcome.status), 1);
}

TEST(SignalRelayTest, ASignalMakesTheFileReadableAndIsTakenOnce)
{
    const SignalRelay relay;
    pollfd readable {relay.file(), POLLIN, 0};
    EXPECT_EQ(::poll(&readable, 1, 0), 0);
    ::raise(SIGWINCH);
    EXPECT_EQ(::poll(&readable, 1, 0), 1);
    relay.clear();
    EXPECT_EQ(::poll(&readable, 1, 0), 0);
    EXPECT_FALSE(SignalRelay::take(SIGTERM));
    EXPECT_TRUE(SignalRelay::take(SIGWINCH));
    EXPECT_FALSE(SignalRelay::take(SIGWINCH));
}

TEST(SignalRelayTest, ASecondWishToEndEndsAProgramThatDoesNotListen)
{
    const Ended outcome = runOnTerminal("xterm", [] {
        const SignalRelay relay;
        const auto terminal = showText("text");
        ::raise(SIGTERM);
        ::raise(SIGTERM);
    });
    EXPECT_NE(afterScreen(outcome.output), "never left");
    ASSERT_TRUE(WIFSIGNALED(outcome.status));
    EXPECT_EQ(WTERMSIG(outcome.status), SIGTERM);
}

} // namespace
} // namespace spectrel
