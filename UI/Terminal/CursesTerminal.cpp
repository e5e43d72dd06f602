#include "UI/Terminal/CursesTerminal.h"

#include "Values/Base64.h"

#include <algorithm>
#include <array>
#include <clocale>
#include <cstdio>
#include <cstdlib>
#include <langinfo.h>
#include <ncurses.h>
#include <poll.h>
#include <string_view>
#include <sys/ioctl.h>
#include <term.h>
#include <unistd.h>

// The terminal library spells common words as macros.
#undef lines
#undef columns

namespace spectrel {

namespace {

constexpr short AccentPair = 1;
constexpr short WarningPair = 2;
constexpr int EscapeDelay = 25; // ms that the rest of a key's sequence may take

/// A terminal's string as it is sent, without its delays; empty when it has none.
std::string capability(const char* name)
{
    const char* value = ::tigetstr(name);
    if (value == nullptr || value == reinterpret_cast<const char*>(-1))
        return {};
    std::string sent(value);
    for (auto start = sent.find("$<"); start != std::string::npos; start = sent.find("$<", start)) {
        const auto end = sent.find('>', start);
        if (end == std::string::npos)
            break;
        sent.erase(start, end - start + 1);
    }
    return sent;
}

/// What stands for a character on a terminal that has only ASCII.
char32_t inASCII(char32_t character)
{
    constexpr std::array<std::pair<char32_t, char32_t>, 15> Likenesses {
        {{U'‹', U'<'}, {U'›', U'>'}, {U'…', U'~'}, {U'✓', U'x'}, {U'─', U'-'}, {U'│', U'|'}, {U'┌', U'+'}, {U'┐', U'+'},
            {U'└', U'+'}, {U'┘', U'+'}, {U'°', U'o'}, {U'–', U'-'}, {U'━', U'='}, {U'▶', U'>'}, {U'‖', U'|'}}};
    if (character < 0x7F)
        return character;
    const auto found =
        std::ranges::find_if(Likenesses, [character](const auto& pair) { return pair.first == character; });
    return found == Likenesses.end() ? U'?' : found->second;
}

} // namespace

struct CursesTerminal::Screen {
    explicit Screen(SCREEN* opened)
        : handle(opened)
    {
    }
    ~Screen()
    {
        ::endwin();
        ::delscreen(handle);
    }
    Screen(const Screen&) = delete;
    Screen& operator=(const Screen&) = delete;
    SCREEN* handle;
};

Result<std::unique_ptr<CursesTerminal>> CursesTerminal::open()
{
    if (::isatty(STDIN_FILENO) == 0 || ::isatty(STDOUT_FILENO) == 0)
        return Failure {"standard input and output are no terminal"};
    std::setlocale(LC_CTYPE, "");
    std::unique_ptr<CursesTerminal> terminal(new CursesTerminal());
    terminal->_isUTF8 = std::string_view(::nl_langinfo(CODESET)) == "UTF-8";
    terminal->_guard = std::make_unique<TerminalGuard>();
    SCREEN* screen = ::newterm(nullptr, stdout, stdin);
    if (!screen) {
        const char* name = std::getenv("TERM");
        return Failure {std::string("cannot draw on a terminal of the kind \"") + (name ? name : "") + "\""};
    }
    TerminalGuard::arm();
    terminal->_screen = std::make_unique<Screen>(screen);
    terminal->startScreen();
    return terminal;
}

CursesTerminal::~CursesTerminal()
{
    _screen.reset();
}

void CursesTerminal::startScreen()
{
    ::cbreak();
    ::noecho();
    ::nonl();
    ::keypad(stdscr, TRUE);
    ::nodelay(stdscr, TRUE);
    ::set_escdelay(EscapeDelay);
    ::curs_set(0);
    ::mouseinterval(0); // a press counts at once
    ::mousemask(BUTTON1_PRESSED | BUTTON4_PRESSED | BUTTON5_PRESSED, nullptr);
    if (::has_colors() && std::getenv("NO_COLOR") == nullptr) {
        ::start_color();
        ::use_default_colors();
        ::init_pair(AccentPair, COLOR_CYAN, -1);
        ::init_pair(WarningPair, COLOR_YELLOW, -1);
        _hasColours = true;
    }
    rememberLeavingSequence();
    updateSize();
}

void CursesTerminal::rememberLeavingSequence() const
{
    std::string sequence;
    if (::has_mouse())
        sequence += "\033[?1006l\033[?1003l\033[?1002l\033[?1000l";
    if (_hasColours)
        sequence += capability("op");
    for (const char* name : {"sgr0", "rmkx", "rmcup", "cnorm"})
        sequence += capability(name);
    TerminalGuard::setLeavingSequence(sequence);
}

int CursesTerminal::width() const
{
    return getmaxx(stdscr);
}

int CursesTerminal::height() const
{
    return getmaxy(stdscr);
}

void CursesTerminal::updateSize()
{
    winsize size {};
    if (::ioctl(STDOUT_FILENO, TIOCGWINSZ, &size) == 0 && size.ws_row > 0 && size.ws_col > 0)
        ::resizeterm(size.ws_row, size.ws_col);
}

void CursesTerminal::copy(const std::string& text) const
{
    // The library has written out all of its own at the end of the last drawing.
    std::string sequence = "\033]52;c;";
    appendBase64(sequence, {reinterpret_cast<const std::uint8_t*>(text.data()), text.size()});
    sequence += '\a';
    std::fwrite(sequence.data(), 1, sequence.size(), stdout);
    std::fflush(stdout);
}

void CursesTerminal::forgetShown()
{
    _hasShown = false;
}

void CursesTerminal::showCell(int x, int y, const GridCell& cell) const
{
    std::array<wchar_t, 5> text {};
    for (std::size_t index = 0; index < cell.text.size(); ++index)
        text[index] = static_cast<wchar_t>(_isUTF8 ? cell.text[index] : inASCII(cell.text[index]));
    if (!_isUTF8)
        text[1] = 0;
    attr_t attributes = A_NORMAL;
    attributes |= cell.style.isBold ? A_BOLD : A_NORMAL;
    attributes |= cell.style.isReversed ? A_REVERSE : A_NORMAL;
    attributes |= cell.style.isFaint ? A_DIM : A_NORMAL;
    short pair = 0;
    if (_hasColours && cell.style.tint != Tint::Plain)
        pair = cell.style.tint == Tint::Accent ? AccentPair : WarningPair;
    cchar_t shown {};
    if (::setcchar(&shown, text.data(), attributes, pair, nullptr) == OK)
        mvadd_wch(y, x, &shown);
    if (!_isUTF8 && cell.columns == 2)
        mvadd_wch(y, x + 1, &shown);
}

void CursesTerminal::show(const Grid& grid)
{
    const bool showsAll = !_hasShown || _shown.width() != grid.width() || _shown.height() != grid.height();
    if (showsAll) {
        ::werase(stdscr);
        ::clearok(stdscr, TRUE);
    }
    for (int y = 0; y < std::min(grid.height(), height()); ++y) {
        for (int x = 0; x < std::min(grid.width(), width()); ++x) {
            const GridCell& cell = grid.at(x, y);
            if (cell.columns > 0 && (showsAll || cell != _shown.at(x, y)))
                showCell(x, y, cell);
        }
    }
    ::refresh();
    _shown = grid;
    _hasShown = true;
}

void CursesTerminal::readMouse(const std::function<void(const InputEvent&)>& handler) const
{
    MEVENT mouse {};
    if (::getmouse(&mouse) != OK)
        return;
    if (const auto event = KeyDecoder::mouse(mouse.bstate, mouse.x, mouse.y))
        handler(*event);
}

bool CursesTerminal::read(const std::function<void(const InputEvent&)>& handler)
{
    constexpr int Batch = 256; // a paste must not starve the rest
    wint_t code = 0;
    for (int count = 0; count < Batch; ++count) {
        const int result = ::get_wch(&code);
        if (result == ERR) {
            _decoder.flush(handler);
            break;
        }
        if (result == KEY_CODE_YES && code == KEY_MOUSE)
            readMouse(handler);
        else
            _decoder.feed({result == KEY_CODE_YES, code}, handler);
    }
    pollfd input {STDIN_FILENO, POLLIN, 0};
    return ::poll(&input, 1, 0) < 0 || (input.revents & (POLLHUP | POLLERR | POLLNVAL)) == 0;
}

void CursesTerminal::suspend()
{
    ::endwin();
}

void CursesTerminal::resume()
{
    updateSize();
    ::refresh(); // takes the terminal again
    forgetShown();
}

} // namespace spectrel
