#include "Platform/Qt/TerminationSignals.h"

#include <QSocketNotifier>

#include <cerrno>
#include <csignal>
#include <fcntl.h>
#include <system_error>
#include <unistd.h>
#include <utility>
#include <vector>

namespace spectrel {

namespace {

int writingEnd = -1; // of the pipe that carries the signals' numbers out of the signal handler

volatile std::sig_atomic_t isAskedToEnd = 0; // the next signal ends the process, whatever it is busy with

/// Ends the process as if nobody had listened to the signal.
void endBy(int signal)
{
    struct sigaction action = {};
    action.sa_handler = SIG_DFL;
    ::sigaction(signal, &action, nullptr);
    ::raise(signal); // comes when the handler has returned
}

bool asksToEnd(int signal)
{
    return signal == SIGINT || signal == SIGTERM || signal == SIGHUP;
}

void noteSignal(int signal)
{
    if (asksToEnd(signal)) {
        if (isAskedToEnd)
            return endBy(signal);
        isAskedToEnd = 1;
    }
    const int kept = errno;
    const auto number = static_cast<unsigned char>(signal);
    [[maybe_unused]] const auto written = ::write(writingEnd, &number, 1);
    errno = kept;
}

} // namespace

struct TerminationSignals::Private {
    Private(Handler called, std::initializer_list<int> further)
        : handler(std::move(called))
    {
        for (const int signal : further)
            former.push_back({signal, {}});
        if (::pipe2(ends, O_CLOEXEC | O_NONBLOCK) != 0)
            throw std::system_error(errno, std::generic_category(), "the signals get no pipe");
        writingEnd = ends[1];
        isAskedToEnd = 0;
        notifier = std::make_unique<QSocketNotifier>(ends[0], QSocketNotifier::Read);
        QObject::connect(notifier.get(), &QSocketNotifier::activated, [this] { take(); });
        struct sigaction action = {};
        action.sa_handler = noteSignal;
        action.sa_flags = SA_RESTART;
        for (Former& each : former)
            ::sigaction(each.signal, &action, &each.action);
    }
    ~Private()
    {
        for (const Former& each : former)
            ::sigaction(each.signal, &each.action, nullptr);
        notifier.reset();
        writingEnd = -1;
        ::close(ends[0]);
        ::close(ends[1]);
    }
    void take()
    {
        unsigned char number = 0;
        if (::read(ends[0], &number, 1) != 1)
            return;
        const Handler running = handler; // a copy: the handler may end this object
        running(number);
    }

    Handler handler;
    int ends[2] = {-1, -1};
    std::unique_ptr<QSocketNotifier> notifier;
    struct Former {
        int signal;
        struct sigaction action;
    };
    std::vector<Former> former {{SIGINT, {}}, {SIGTERM, {}}, {SIGHUP, {}}};
};

TerminationSignals::TerminationSignals(Handler handler, std::initializer_list<int> further)
    : _private(std::make_unique<Private>(std::move(handler), further))
{
}

TerminationSignals::~TerminationSignals() = default;

} // namespace spectrel
