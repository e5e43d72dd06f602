#pragma once

#include "Analysis/Analysis.h"
#include "Analysis/Cell.h"
#include "Analysis/Events/Event.h"
#include "Values/Moment.h"
#include "Values/Result.h"

#include <chrono>
#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

namespace spectrel {

/// When an alarm is raised: 'LEVEL OP NUMBER [for TIME]', such as 'RSRP < -110 for 10s' or
/// '"/Serving Cell Measurements/Srxlev" <= 4'.
struct AlarmCondition {
    enum class Operator : std::uint8_t { Less, LessOrEqual, Greater, GreaterOrEqual, Equal, NotEqual };

    std::optional<Level> level; // of the serving cell; without it `path` tells the leaf
    std::string path; // in the display tree
    Operator op = Operator::Less;
    double number = 0; // in the unit that the level or the leaf has
    std::chrono::milliseconds time {0}; // for which it has to hold; 0: at once
    std::string text; // as it was given

    bool isMetBy(double value) const;
};

/// LEVEL is a level's name or a path between double or single quotes, OP one of < <= > >= == !=, TIME a number and one
/// of ms, s, m, h.
Result<AlarmCondition> parseAlarm(std::string_view text);

/// Hears of alarms, at the message that raises them.
class AlarmListener {
public:
    virtual ~AlarmListener() = default;
    virtual void alarmRaised(const AlarmCondition& condition, const Event& event) = 0;
};

/// Raises one alarm each time its condition has come to hold for its time. What is not known meets no condition.
class AlarmWatch final : public AnalysisListener {
public:
    /// Listens to the analysis from now on. Both are there for as long as this is.
    AlarmWatch(AlarmCondition condition, Analysis& analysis, AlarmListener& listener);
    ~AlarmWatch() override;
    AlarmWatch(const AlarmWatch&) = delete;
    AlarmWatch& operator=(const AlarmWatch&) = delete;

    void messageAnalysed(const AppliedMessage& message, const Journal& journal, const Analysis& analysis,
        const AnalysedChanges& changes) override;
    void refreshed(const CellReport& report, const Analysis& analysis) override;

private:
    void readLevel(const Analysis& analysis);
    void readLeaf(const Journal& journal);
    void consider(std::uint64_t n, Moment time);

    AlarmCondition _condition;
    Analysis& _analysis;
    AlarmListener& _listener;
    std::optional<double> _value; // as it stands
    std::optional<Moment> _since; // when the condition began to hold
    bool _isRaised = false; // since then
    std::uint64_t _latest = 0; // message
};

} // namespace spectrel
