#include "Platform/Qt/QtRunLoop.h"

#include <QCoreApplication>
#include <QSocketNotifier>
#include <QTimer>

#include <array>
#include <cerrno>
#include <clocale>
#include <cstdint>
#include <deque>
#include <limits>
#include <sys/eventfd.h>
#include <system_error>
#include <unistd.h>
#include <utility>

namespace spectrel {

namespace {

/// Whole milliseconds, rounded up: nothing runs before it is due.
int milliseconds(std::chrono::nanoseconds duration)
{
    const auto whole = std::chrono::ceil<std::chrono::milliseconds>(duration).count();
    if (whole <= 0)
        return 0;
    return whole > std::numeric_limits<int>::max() ? std::numeric_limits<int>::max() : static_cast<int>(whole);
}

/// The event loop of Qt ends the process where it gets no descriptors, without a word that helps: the few that it takes
/// are asked for before.
void requireDescriptors()
{
    constexpr std::size_t Needed = 8;
    std::array<int, Needed> taken {};
    int error = 0;
    for (int& each : taken) {
        each = ::eventfd(0, EFD_CLOEXEC);
        error = each < 0 ? errno : error;
    }
    for (const int each : taken) {
        if (each >= 0)
            ::close(each);
    }
    if (error != 0)
        throw std::system_error(error, std::generic_category(), "the run loop gets no descriptors");
}

/// An application object, where no front end has made one.
std::unique_ptr<QCoreApplication> makeApplication()
{
    if (QCoreApplication::instance())
        return nullptr;
    requireDescriptors();
    static int count = 1;
    static char name[] = "spectrel";
    static char* arguments[] = {name, nullptr};
    auto application = std::make_unique<QCoreApplication>(count, arguments);
    std::setlocale(LC_NUMERIC, "C"); // the application object has adopted the user's locale; our numbers have none
    return application;
}

struct RepeatingTimer final : Timer {
    QTimer timer;
};

int makeWakeUp()
{
    const int descriptor = ::eventfd(0, EFD_CLOEXEC | EFD_NONBLOCK);
    if (descriptor < 0)
        throw std::system_error(errno, std::generic_category(), "the run loop gets no descriptor");
    return descriptor;
}

} // namespace

/// The job queue, woken through a descriptor: unlike posted events it takes turns with sockets and timers.
struct QtRunLoop::Queue {
    Queue()
        : application(makeApplication())
        , wakeUp(makeWakeUp())
        , notifier(wakeUp, QSocketNotifier::Read)
    {
        QObject::connect(&notifier, &QSocketNotifier::activated, [this] { runTurn(); });
    }
    ~Queue()
    {
        notifier.setEnabled(false);
        ::close(wakeUp);
    }

    void push(Job job)
    {
        jobs.push_back(std::move(job));
        if (!std::exchange(isWoken, true)) {
            const std::uint64_t one = 1;
            [[maybe_unused]] const auto written = ::write(wakeUp, &one, sizeof one);
        }
    }
    void runTurn()
    {
        std::uint64_t count = 0;
        [[maybe_unused]] const auto taken = ::read(wakeUp, &count, sizeof count);
        isWoken = false;
        // A job may turn the loop itself, which then takes jobs of this turn.
        for (std::size_t left = jobs.size(); left > 0 && !jobs.empty(); --left) {
            const Job job = std::move(jobs.front());
            jobs.pop_front();
            job();
        }
    }

    std::unique_ptr<QCoreApplication> application;
    int wakeUp;
    QSocketNotifier notifier;
    QObject delayed; // owns the delayed jobs: they end with the loop
    std::deque<Job> jobs;
    bool isWoken = false; // a turn is to come that takes what the queue holds
};

QtRunLoop::QtRunLoop()
    : _queue(std::make_unique<Queue>())
{
}

QtRunLoop::~QtRunLoop() = default;

void QtRunLoop::async(Job job)
{
    _queue->push(std::move(job));
}

void QtRunLoop::after(std::chrono::nanoseconds delay, Job job)
{
    // More than the timer can count, some 24 days, is waited for in parts.
    constexpr std::chrono::milliseconds Longest(std::numeric_limits<int>::max());
    if (delay > Longest) {
        after(Longest, [this, rest = delay - Longest, job = std::move(job)] { after(rest, job); });
        return;
    }
    QTimer::singleShot(milliseconds(delay), Qt::PreciseTimer, &_queue->delayed, std::move(job));
}

std::unique_ptr<Timer> QtRunLoop::repeat(std::chrono::nanoseconds interval, Job action)
{
    auto repeating = std::make_unique<RepeatingTimer>();
    repeating->timer.setTimerType(Qt::PreciseTimer);
    // A copy runs: the action may destroy its timer, and with it the connection.
    QObject::connect(&repeating->timer, &QTimer::timeout, [action = std::move(action)] {
        const Job running = action;
        running();
    });
    repeating->timer.start(milliseconds(interval));
    return repeating;
}

int QtRunLoop::run()
{
    return QCoreApplication::exec();
}

void QtRunLoop::quit(int status)
{
    QCoreApplication::exit(status);
}

bool QtRunLoop::runUntil(const std::function<bool()>& done, std::chrono::nanoseconds limit)
{
    bool isOver = false;
    QTimer atLimit;
    atLimit.setSingleShot(true);
    atLimit.setTimerType(Qt::PreciseTimer);
    QObject::connect(&atLimit, &QTimer::timeout, [&isOver] { isOver = true; });
    atLimit.start(milliseconds(limit));
    while (!done()) {
        if (isOver)
            return false;
        QCoreApplication::processEvents(QEventLoop::WaitForMoreEvents);
    }
    return true;
}

} // namespace spectrel
