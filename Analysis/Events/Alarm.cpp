#include "Analysis/Events/Alarm.h"

#include "Analysis/Events/MoveText.h"
#include "Values/Table.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <utility>

namespace spectrel {

namespace {

using Operator = AlarmCondition::Operator;

struct NamedOperator {
    std::string_view name;
    Operator op;
};
constexpr std::array<NamedOperator, 6> Operators {{
    {"<", Operator::Less},
    {"<=", Operator::LessOrEqual},
    {">", Operator::Greater},
    {">=", Operator::GreaterOrEqual},
    {"==", Operator::Equal},
    {"!=", Operator::NotEqual},
}};

struct Unit {
    std::string_view name;
    double milliseconds;
};
constexpr std::array<Unit, 4> Units {{{"ms", 1}, {"s", 1e3}, {"m", 60e3}, {"h", 3600e3}}};
constexpr double LongestTime = 7 * 24 * 3600e3; // milliseconds

constexpr std::string_view OperatorCharacters = "<>=!";
constexpr std::string_view NumberCharacters = "+-.0123456789eE";

/// Takes words from the front of a text.
class Words {
public:
    explicit Words(std::string_view text)
        : _rest(text)
    {
        skipBlanks();
    }
    bool isAtEnd() const
    {
        return _rest.empty();
    }
    /// The longest beginning of these characters; empty where there is none.
    std::string_view takeAll(std::string_view characters)
    {
        return take(std::min(_rest.find_first_not_of(characters), _rest.size()));
    }
    /// Up to the next blank or operator.
    std::string_view takeWord()
    {
        return take(std::min(_rest.find_first_of(" \t<>=!"), _rest.size()));
    }
    /// A text between quotes; none where there are not two.
    std::optional<std::string_view> takeQuoted()
    {
        if (_rest.empty() || (_rest.front() != '"' && _rest.front() != '\''))
            return std::nullopt;
        const std::size_t end = _rest.find(_rest.front(), 1);
        if (end == std::string_view::npos)
            return std::nullopt;
        const std::string_view quoted = _rest.substr(1, end - 1);
        take(end + 1);
        return quoted;
    }

private:
    std::string_view take(std::size_t count)
    {
        const std::string_view word = _rest.substr(0, count);
        _rest.remove_prefix(count);
        skipBlanks();
        return word;
    }
    void skipBlanks()
    {
        _rest.remove_prefix(std::min(_rest.find_first_not_of(" \t"), _rest.size()));
    }

    std::string_view _rest;
};

/// A finite number; none for anything else.
std::optional<double> numberIn(std::string_view text)
{
    if (text.starts_with('+'))
        text.remove_prefix(1);
    double number = 0;
    const auto end = std::from_chars(text.data(), text.data() + text.size(), number);
    const bool isWhole = end.ec == std::errc() && end.ptr == text.data() + text.size();
    return isWhole && number - number == 0 ? std::optional(number) : std::nullopt;
}

std::optional<std::chrono::milliseconds> timeIn(std::string_view text)
{
    const std::size_t digits = std::min(text.find_first_not_of("0123456789."), text.size());
    const auto number = numberIn(text.substr(0, digits));
    const Unit* const unit = findRow(Units, text.substr(digits), &Unit::name);
    if (!number || !unit || *number * unit->milliseconds > LongestTime)
        return std::nullopt;
    return std::chrono::milliseconds(static_cast<std::int64_t>(*number * unit->milliseconds));
}

/// The number that a leaf's text begins with: "-104.50 dBm", "+3.79 dB".
std::optional<double> leadingNumber(std::string_view text)
{
    return numberIn(Words(text).takeAll(NumberCharacters));
}

Failure failure(std::string_view text, const std::string& reason)
{
    return Failure {"'" + std::string(text) + "' is no alarm such as 'RSRP < -110 for 10s': " + reason};
}

} // namespace

bool AlarmCondition::isMetBy(double value) const
{
    switch (op) {
    case Operator::Less:
        return value < number;
    case Operator::LessOrEqual:
        return value <= number;
    case Operator::Greater:
        return value > number;
    case Operator::GreaterOrEqual:
        return value >= number;
    case Operator::Equal:
        return value == number;
    case Operator::NotEqual:
        return value != number;
    }
    return false;
}

Result<AlarmCondition> parseAlarm(std::string_view text)
{
    AlarmCondition condition;
    condition.text = text;
    Words words(text);
    if (const auto path = words.takeQuoted()) {
        condition.path = *path;
        if (!path->starts_with('/'))
            return failure(text, "a path begins with /");
    } else {
        const std::string_view name = words.takeWord();
        condition.level = levelNamed(name);
        if (!condition.level)
            return failure(text, "there is no level '" + std::string(name) + "', and a path stands in quotes");
    }
    const NamedOperator* const op = findRow(Operators, words.takeAll(OperatorCharacters), &NamedOperator::name);
    if (!op)
        return failure(text, "one of <, <=, >, >=, ==, != is missing");
    condition.op = op->op;
    const auto number = numberIn(words.takeAll(NumberCharacters));
    if (!number)
        return failure(text, "the number is missing");
    condition.number = *number;
    if (words.isAtEnd())
        return condition;
    const bool hasFor = words.takeWord() == "for";
    const auto time = timeIn(words.takeWord());
    if (!hasFor || !time || !words.isAtEnd())
        return failure(text, "after the number stands nothing, or 'for' and a time such as 10s");
    condition.time = *time;
    return condition;
}

AlarmWatch::AlarmWatch(AlarmCondition condition, Analysis& analysis, AlarmListener& listener)
    : _condition(std::move(condition))
    , _analysis(analysis)
    , _listener(listener)
{
    _analysis.addListener(*this);
}

AlarmWatch::~AlarmWatch()
{
    _analysis.removeListener(*this);
}

void AlarmWatch::messageAnalysed(
    const AppliedMessage& message, const Journal& journal, const Analysis& analysis, const AnalysedChanges& changes)
{
    _latest = message.number;
    if (!_condition.level)
        readLeaf(journal);
    else if (changes.serving)
        readLevel(analysis);
    consider(message.number, message.time);
}

void AlarmWatch::refreshed(const CellReport& report, const Analysis&)
{
    consider(_latest, report.time);
}

void AlarmWatch::readLevel(const Analysis& analysis)
{
    const Cell* const serving = analysis.serving();
    _value = serving ? serving->level(*_condition.level) : std::nullopt;
}

void AlarmWatch::readLeaf(const Journal& journal)
{
    const std::string_view path = _condition.path;
    const std::string_view name = path.substr(path.rfind('/') + 1);
    for (const Journal::Change& change : journal.changes()) {
        // Most leaves have another name, and so their paths need not be put together.
        if (!journal.keyOf(change).ends_with(name) || journal.pathOf(change) != path)
            continue;
        const bool isThere = change.kind != Journal::Kind::Removed;
        _value = isThere ? leadingNumber(journal.valueOf(change)) : std::nullopt;
    }
}

void AlarmWatch::consider(std::uint64_t n, Moment time)
{
    if (!_value || !_condition.isMetBy(*_value)) {
        _since.reset();
        _isRaised = false;
        return;
    }
    if (!_since)
        _since = time;
    if (_isRaised || time - *_since < _condition.time)
        return;
    _isRaised = true;
    Event event;
    event.n = n;
    event.time = time;
    event.kind = EventKind::Alarm;
    event.condition = _condition.text;
    event.value = _value;
    event.text = "Alarm: " + _condition.text + " (now " + numberText(*_value) + ")";
    _listener.alarmRaised(_condition, event);
}

} // namespace spectrel
