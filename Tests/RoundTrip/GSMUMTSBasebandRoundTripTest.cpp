#include "Telephony/Simulator/Baseband.h"
#include "Tests/RoundTrip/GSMUMTSRoundTrip.h"

#include <set>

namespace spectrel {
namespace {

using namespace std::chrono_literals;

class GSMUMTSBasebandRoundTripTest : public GSMUMTSRoundTrip {
protected:
    /// Everything the baseband sends goes into the display.
    void receive(Baseband& baseband, std::chrono::milliseconds time)
    {
        const auto emit = [this](ByteView record) { deliver(record); };
        for (auto passed = 0ms; passed < time; passed += Baseband::Step) {
            _now += Baseband::Step;
            baseband.advance(_now, emit);
            if (passed % 1s == 0ms)
                see(display());
        }
    }
    /// Paths of the dictionaries' entries that have never shown anything but a dash, lists that were never filled.
    std::set<std::string> stillEmpty() const
    {
        std::set<std::string> paths;
        for (const std::string& path : _all) {
            if (!_filled.contains(path))
                paths.insert(path);
        }
        return paths;
    }

private:
    void see(const Value& value, const std::string& path = {})
    {
        if (const auto& dictionary = value.dictionary()) {
            for (const auto& [key, inner] : dictionary->entries())
                see(inner, path.empty() ? key : path + "/" + key);
            return;
        }
        _all.insert(path);
        const bool isEmptyList = value.list() && value.list()->count() == 0;
        if (!isEmptyList && value != Value("-"))
            _filled.insert(path);
    }

    std::set<std::string> _all;
    std::set<std::string> _filled;
    Moment _now {};
};

TEST_F(GSMUMTSBasebandRoundTripTest, EverySectionComesAliveWithinTwoLaps)
{
    const auto baseband = makeBaseband(Technology::GSM, Scene::Drive, 28);
    receive(*baseband, 10min);
    EXPECT_EQ(stillEmpty(),
        (std::set<std::string> {"GSM/Coding Scheme", "GSM/Non-Ranked GSM Set", "Network/Cell Change Counters",
            "UMTS/Detected Set", "UMTS/Monitored Set", "UMTS/Non-Ranked UMTS Set", "UMTS/UMTS RR Measurement",
            "UMTS/Virtual Active Set"}))
        << "these never show anything";
}

TEST_F(GSMUMTSBasebandRoundTripTest, StressIsTakenWithoutComplaint)
{
    recorder.takeLog(); // what its making says
    const auto baseband = makeBaseband(Technology::GSM, Scene::Stress, 1);
    receive(*baseband, 30s);
    EXPECT_EQ(recorder.takeLog(), "") << "nothing unreadable, nothing unknown";
}

TEST_F(GSMUMTSBasebandRoundTripTest, StrongestCellOfTheActiveSetIsTheServingOneAtAnyMoment)
{
    const auto baseband = makeBaseband(Technology::GSM, Scene::Drive, 1);
    std::set<std::string> cells;
    for (int step = 0; step < 6000 && !HasFailure(); ++step) {
        receive(*baseband, Baseband::Step);
        if (list("Active Set").count() == 0)
            continue;
        const std::string serving = shown("UMTS RR Info", "Scrambling Code");
        EXPECT_EQ(text(entry("Active Set", 0), "Scrambling Code"), serving) << "in step " << step;
        cells.insert(serving);
    }
    EXPECT_GT(cells.size(), 5u);
}

TEST_F(GSMUMTSBasebandRoundTripTest, ActiveSetIsEmptyWhileOnGSM)
{
    const auto baseband = makeBaseband(Technology::GSM, Scene::Drive, 1);
    std::size_t seconds = 0;
    for (int second = 0; second < 600; ++second) {
        receive(*baseband, 1s);
        const std::string state = shown("GSM RR Info", "RR State");
        if (state == "RR_IDLE") {
            EXPECT_EQ(list("Active Set").count(), 0u);
            EXPECT_EQ(shown("UMTS RR Info", "RRC State"), "Disconnected");
            ++seconds;
        }
        if (state == "RR_INACTIVE" && shown("UMTS RR Info", "RRC State") == "CELL_DCH") {
            EXPECT_GE(list("Active Set").count(), 1u);
        }
        if (HasFailure())
            return;
    }
    EXPECT_GT(seconds, 10u);
}

} // namespace
} // namespace spectrel
