// quick_benchmark: the graphical screens over a model with as many rows as asked for (500).
//
// Measures with the real QML in a window: when the first frame was there, what a reload costs until its frame is drawn,
// how long frames take while the rows scroll and reload at once, how many frames are drawn while nothing happens, and
// the memory. Each time stands beside the length of a frame at 60 Hz. Exits with 1 when the rows show something else
// than the model's values, when a reload or a frame takes too long, or a frame is drawn for nothing. With --prove as
// its only argument it looks at the rows alone.

#include "Platform/Preferences.h"
#include "Platform/Qt/QtClock.h"
#include "Platform/Qt/QtRunLoop.h"
#include "Tests/Fakes/FakeModel.h"
#include "UI/Quick/QuickFrontEnd.h"
#include "UI/SpectrelApp.h"
#include "Values/Dictionary.h"

#include <QGuiApplication>
#include <QQuickItem>
#include <QQuickWindow>

#include <algorithm>
#include <chrono>
#include <cmath>
#include <cstdio>
#include <cstdlib>
#include <fstream>
#include <string>
#include <string_view>
#include <time.h>
#include <unistd.h>
#include <vector>

namespace {

using namespace spectrel;
using namespace std::chrono_literals;
using Milliseconds = std::chrono::duration<double, std::milli>;
using Instant = std::chrono::steady_clock::time_point;

constexpr double Frame = 1000.0 / 60; // ms
constexpr double LongestFrame = 33; // ms
constexpr auto Patience = 60s;

Milliseconds since(Instant start)
{
    return std::chrono::steady_clock::now() - start;
}

/// From the process's start, as the kernel keeps it in its clock's ticks (10 ms).
double millisecondsSinceExec()
{
    std::ifstream file("/proc/self/stat");
    std::string word;
    for (int field = 1; field <= 22 && file >> word; ++field) { }
    timespec now {};
    ::clock_gettime(CLOCK_BOOTTIME, &now);
    return static_cast<double>(now.tv_sec) * 1e3 + static_cast<double>(now.tv_nsec) / 1e6
        - std::stod(word) * 1e3 / static_cast<double>(::sysconf(_SC_CLK_TCK));
}

double residentMebibytes()
{
    std::ifstream file("/proc/self/statm");
    long pages = 0;
    file >> pages >> pages;
    return static_cast<double>(pages) * static_cast<double>(::sysconf(_SC_PAGESIZE)) / (1024 * 1024);
}

Value display(int rows, int round)
{
    const DictionaryRef values = Dictionary::make();
    for (int row = 0; row < rows; ++row)
        values->set("Neighbour " + std::to_string(row), Value("-" + std::to_string((row * 7 + round) % 140) + " dBm"));
    return values;
}

void print(const char* what, std::vector<double> times)
{
    std::ranges::sort(times);
    const auto at = [&times](
                        double share) { return times[static_cast<std::size_t>(share * double(times.size() - 1))]; };
    std::printf("%-34s p50 %6.2f ms  p99 %6.2f ms  max %6.2f ms  (p50 is %.0f %% of a frame, %zu times)\n", what,
        at(0.5), at(0.99), at(1), at(0.5) / Frame * 100, times.size());
}

QQuickItem* itemNamed(const QQuickItem& parent, const QString& name)
{
    for (QQuickItem* child : parent.childItems()) {
        QQuickItem* const found = child->objectName() == name ? child : itemNamed(*child, name);
        if (found)
            return found;
    }
    return nullptr;
}

class Benchmark {
public:
    enum class Measure { Everything, NothingButRows };

    Benchmark(int rows, Measure measure)
        : _rows(rows)
        , _measure(measure)
    {
    }

    bool run()
    {
        if (const Outcome started = _frontEnd.start(); !started) {
            std::fprintf(stderr, "quick_benchmark: %s\n", started.failure().text.c_str());
            return false;
        }
        SpectrelApp app({_runLoop, _clock, _preferences, _frontEnd.toolkit(),
            [this](SpectrelModelObserver&) {
                auto made = std::make_unique<FakeModel>();
                made->connected = true;
                _model = made.get();
                return made;
            },
            {}, {}});
        countFrames();
        app.applicationDidFinishLaunching();
        waitForFrame(0);
        std::printf("%-34s %6.0f ms after exec\n", "first frame", millisecondsSinceExec());
        reload(app, 0);
        waitForFrame(_frames);

        const bool isGood = showsRound(0)
            && (_measure == Measure::NothingButRows || (measureReloads(app) & measureScrolling(app) & measureIdle()));
        std::printf("%-34s %6.1f MiB\n", "resident", residentMebibytes());
        app.applicationWillTerminate();
        _frontEnd.stop();
        return isGood;
    }

private:
    void countFrames()
    {
        QObject::connect(_frontEnd.window(), &QQuickWindow::afterAnimating,
            [this] { _frameStart = std::chrono::steady_clock::now(); });
        QObject::connect(_frontEnd.window(), &QQuickWindow::frameSwapped, [this] {
            ++_frames;
            _frameTimes.push_back(since(_frameStart).count());
        });
    }
    void waitForFrame(int after)
    {
        _runLoop.runUntil([this, after] { return _frames > after; }, Patience);
    }
    void turnFor(std::chrono::milliseconds duration)
    {
        const auto start = std::chrono::steady_clock::now();
        _runLoop.runUntil([start, duration] { return since(start) >= duration; }, duration);
    }
    void reload(SpectrelApp& app, int round)
    {
        _model->setDisplay(display(_rows, round)); // decoding and the tree are not the screens' work
        app.updateViewControllerFromModel();
    }

    /// Whether the list has a row for each value and the rows in sight show that round's values.
    bool showsRound(int round)
    {
        const QQuickItem* const list = itemNamed(*_frontEnd.window()->contentItem(), "rows");
        const Value wanted = display(_rows, round);
        int seen = 0;
        for (const QQuickItem* row : list->property("contentItem").value<QQuickItem*>()->childItems()) {
            if (row->objectName() != "row" || !row->isVisible())
                continue;
            const std::string name = row->property("name").toString().toStdString();
            const auto value = (*wanted.dictionary())[name].string();
            if (!value || row->property("value").toString().toStdString() != *value) {
                std::fprintf(stderr, "quick_benchmark: the row \"%s\" shows a wrong value\n", name.c_str());
                return false;
            }
            ++seen;
        }
        const int rows = list->property("count").toInt();
        std::printf("%-34s %6d of %d rows in sight, each with its value\n", "shown", seen, rows);
        return seen > 0 && rows == _rows;
    }

    bool measureReloads(SpectrelApp& app)
    {
        std::vector<double> times;
        for (int round = 1; round <= 200; ++round) {
            _model->setDisplay(display(_rows, round));
            const int before = _frames;
            _frameTimes.clear();
            const auto start = std::chrono::steady_clock::now();
            app.updateViewControllerFromModel();
            const double update = since(start).count();
            waitForFrame(before);
            times.push_back(update + _frameTimes.front()); // without the wait between the two
        }
        print("reload until its frame is drawn", times);
        std::ranges::sort(times);
        return showsRound(200) && times[times.size() / 2] < Frame;
    }

    bool measureScrolling(SpectrelApp& app)
    {
        QQuickItem* const list = itemNamed(*_frontEnd.window()->contentItem(), "rows");
        const double end = list->property("contentHeight").toDouble() - list->height();
        std::vector<double> times;
        for (int step = 0; step < 600; ++step) {
            const int before = _frames;
            _frameTimes.clear();
            const auto start = std::chrono::steady_clock::now();
            list->setProperty("contentY", std::fmod(step * 37.0, end)); // a fast flick: 2200 px a second
            if (step % 6 == 0)
                app.updateViewControllerFromModel(); // ten reloads a second instead of one in two seconds
            const double update = since(start).count();
            waitForFrame(before);
            times.push_back(update + _frameTimes.front());
        }
        print("frame while scrolling and reloading", times);
        std::ranges::sort(times);
        return times.back() < LongestFrame;
    }

    bool measureIdle()
    {
        turnFor(2000ms); // the scroll bar fades
        const int before = _frames;
        turnFor(5000ms);
        std::printf("%-34s %6d in 5 s\n", "frames drawn while idle", _frames - before);
        return _frames == before;
    }

    int _rows;
    Measure _measure;
    QtRunLoop _runLoop;
    QtClock _clock;
    NoPreferences _preferences;
    QuickFrontEnd _frontEnd {Appearance::Light};
    FakeModel* _model = nullptr;
    int _frames = 0;
    Instant _frameStart;
    std::vector<double> _frameTimes;
};

} // namespace

int main(int argc, char** argv)
{
    using Measure = Benchmark::Measure;
    const std::string_view argument = argc > 1 ? argv[1] : "500";
    const auto measure = argument == "--prove" ? Measure::NothingButRows : Measure::Everything;
    const int rows = measure == Measure::Everything ? std::atoi(argument.data()) : 500;
    const QGuiApplication application(argc, argv);
    return Benchmark(rows, measure).run() ? 0 : 1;
}
