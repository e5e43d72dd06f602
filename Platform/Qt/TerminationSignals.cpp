#include "Platform/Qt/TerminationSignals.h"

#include <QSocketNotifier>

#include <cerrno>
#include <csignal>
#include <fcntl.h>
#include <unistd.h>
#include <utility>
#include <vector>

namespace spectrel {

namespace {

int writingEnd = -1; // of the pipe that carries the signals' numbers out of the signal handler

void noteSignal(int signal)
{
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
        [[maybe_unused]] const int made = ::pipe2(ends, O_CLOEXEC | O_NONBLOCK);
        writingEnd = ends[1];
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
