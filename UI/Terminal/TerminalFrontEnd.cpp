#include "UI/Terminal/TerminalFrontEnd.h"

#include "UI/Terminal/CursesTerminal.h"
#include "UI/Terminal/SignalRelay.h"
#include "UI/Terminal/TerminalScreen.h"

#include <QSocketNotifier>
#include <chrono>
#include <unistd.h>
#include <utility>

namespace spectrel {

namespace {

constexpr std::chrono::milliseconds SpinnerInterval {150};

} // namespace

class TerminalFrontEnd::Screens {
public:
    explicit Screens(TerminalFrontEnd& frontEnd)
        : screen({[&frontEnd] { frontEnd.needsDisplay(); }, [&frontEnd] { frontEnd.quit(); },
            [&frontEnd](const std::string& text) { frontEnd.copy(text); }})
    {
    }
    TerminalScreen screen;
};

/// What exists while the screens are open.
class TerminalFrontEnd::Session {
public:
    Session(TerminalFrontEnd& frontEnd, std::unique_ptr<SignalRelay> relay, std::unique_ptr<CursesTerminal> terminal)
        : _frontEnd(frontEnd)
        , _screen(frontEnd._screens->screen)
        , _signals(std::move(relay))
        , _terminal(std::move(terminal))
        , _input(STDIN_FILENO, QSocketNotifier::Read)
        , _signalled(_signals->file(), QSocketNotifier::Read)
    {
        QObject::connect(&_input, &QSocketNotifier::activated, &_input, [this] { readInput(); });
        QObject::connect(&_signalled, &QSocketNotifier::activated, &_signalled, [this] { takeSignals(); });
        _screen.resize(_terminal->width(), _terminal->height());
    }

    void copy(const std::string& text)
    {
        _terminal->copy(text);
    }

    void draw()
    {
        _terminal->show(_screen.draw());
        if (_screen.isAnimating() && !_spinnerTimer)
            _spinnerTimer = _frontEnd._runLoop.repeat(SpinnerInterval, [this] { _screen.advanceSpinner(); });
        else if (!_screen.isAnimating())
            _spinnerTimer.reset();
    }

private:
    void readInput()
    {
        const bool isThere = _terminal->read([this](const InputEvent& event) {
            if (const auto* key = std::get_if<KeyEvent>(&event); key && key->key == Key::Redraw)
                _terminal->forgetShown();
            _screen.handle(event);
        });
        if (!isThere) {
            _input.setEnabled(false); // it would be readable for ever
            _frontEnd.quit();
        }
    }

    void takeSignals()
    {
        _signals->clear();
        if (SignalRelay::take(SIGWINCH))
            adoptSize();
        if (SignalRelay::take(SIGTSTP)) {
            _terminal->suspend();
            _signals->stopProcess();
            SignalRelay::take(SIGCONT);
            resume();
        }
        if (SignalRelay::take(SIGCONT)) {
            _terminal->suspend(); // a shell may have used the terminal since the stop
            resume();
        }
        bool ends = false;
        for (const int signal : {SIGINT, SIGTERM, SIGHUP})
            ends |= SignalRelay::take(signal);
        if (ends)
            _frontEnd.quit();
    }

    void adoptSize()
    {
        _terminal->updateSize();
        _screen.resize(_terminal->width(), _terminal->height());
    }

    void resume()
    {
        _terminal->resume();
        _screen.resize(_terminal->width(), _terminal->height());
    }

    TerminalFrontEnd& _frontEnd;
    TerminalScreen& _screen;
    std::unique_ptr<SignalRelay> _signals;
    std::unique_ptr<CursesTerminal> _terminal;
    QSocketNotifier _input;
    QSocketNotifier _signalled;
    std::unique_ptr<Timer> _spinnerTimer;
};

TerminalFrontEnd::TerminalFrontEnd(RunLoop& runLoop)
    : _runLoop(runLoop)
    , _screens(std::make_unique<Screens>(*this))
{
}

TerminalFrontEnd::~TerminalFrontEnd()
{
    stop();
}

ScreenToolkit& TerminalFrontEnd::toolkit()
{
    return _screens->screen;
}

Outcome TerminalFrontEnd::start()
{
    auto relay = std::make_unique<SignalRelay>();
    auto terminal = CursesTerminal::open();
    if (!terminal)
        return terminal.failure();
    relay->install(); // the terminal's library has handlers of its own
    _session = std::make_unique<Session>(*this, std::move(relay), std::move(*terminal));
    return Done {};
}

void TerminalFrontEnd::stop()
{
    _session.reset();
}

void TerminalFrontEnd::quit() const
{
    if (onQuit)
        onQuit();
}

void TerminalFrontEnd::copy(const std::string& text)
{
    if (_session)
        _session->copy(text);
}

/// Draws once the current job has ended, however often it was asked for.
void TerminalFrontEnd::needsDisplay()
{
    if (std::exchange(_isDrawingQueued, true))
        return;
    _runLoop.async(_lifetime.guard([this] {
        _isDrawingQueued = false;
        if (_session)
            _session->draw();
    }));
}

} // namespace spectrel
