#include "Telephony/Sources/ReplayPoint.h"

#include <charconv>
#include <cstddef>

namespace spectrel {

namespace {

/// Takes a text apart from its front; once something does not fit, nothing does.
class Scanner {
public:
    explicit Scanner(std::string_view text)
        : _text(text)
    {
    }
    bool has(char character) const
    {
        return _fits && !_text.empty() && _text.front() == character;
    }
    bool take(char character)
    {
        const bool found = has(character);
        if (found)
            _text.remove_prefix(1);
        return found;
    }
    void expect(char character)
    {
        _fits = take(character) && _fits;
    }
    /// A number of exactly so many digits, at most `max`.
    int number(std::size_t digits, int max)
    {
        int value = 0;
        const std::string_view text = _text.substr(0, digits);
        const auto end = std::from_chars(text.data(), text.data() + text.size(), value);
        _fits = _fits && text.size() == digits && end.ptr == text.data() + digits && value >= 0 && value <= max;
        _text.remove_prefix(text.size());
        return value;
    }
    /// Up to six digits behind the point.
    std::chrono::microseconds fraction()
    {
        std::int64_t micros = 0;
        std::int64_t worth = 100'000;
        for (; !_text.empty() && _text.front() >= '0' && _text.front() <= '9' && worth > 0; worth /= 10) {
            micros += worth * (_text.front() - '0');
            _text.remove_prefix(1);
        }
        return std::chrono::microseconds(micros);
    }
    std::string_view rest() const
    {
        return _text;
    }
    bool isAtEnd() const
    {
        return _fits && _text.empty();
    }
    bool fits() const
    {
        return _fits;
    }

private:
    std::string_view _text;
    bool _fits = true;
};

std::optional<std::chrono::sys_days> takeDay(Scanner& scanner)
{
    const std::chrono::year year(scanner.number(4, 9999));
    scanner.expect('-');
    const auto month = static_cast<unsigned>(scanner.number(2, 12));
    scanner.expect('-');
    const auto day = static_cast<unsigned>(scanner.number(2, 31));
    const std::chrono::year_month_day date(year, std::chrono::month(month), std::chrono::day(day));
    if (!scanner.take('T'))
        scanner.expect(' ');
    if (!scanner.fits() || !date.ok())
        return std::nullopt;
    return std::chrono::sys_days(date);
}

std::chrono::microseconds takeTime(Scanner& scanner)
{
    std::chrono::microseconds time = std::chrono::hours(scanner.number(2, 23));
    scanner.expect(':');
    time += std::chrono::minutes(scanner.number(2, 59));
    if (scanner.take(':')) {
        time += std::chrono::seconds(scanner.number(2, 60));
        if (scanner.take('.'))
            time += scanner.fraction();
    }
    return time;
}

std::optional<std::chrono::minutes> takeZone(Scanner& scanner)
{
    scanner.take(' ');
    if (scanner.take('Z'))
        return std::chrono::minutes(0);
    const bool isWest = scanner.has('-');
    if (!scanner.take('-') && !scanner.take('+'))
        return std::nullopt;
    std::chrono::minutes zone = std::chrono::hours(scanner.number(2, 23));
    scanner.take(':');
    zone += std::chrono::minutes(scanner.number(2, 59));
    return isWest ? -zone : zone;
}

} // namespace

ReplayPoint ReplayPoint::after(std::chrono::microseconds offset)
{
    ReplayPoint point;
    point._time = offset;
    return point;
}

std::optional<ReplayPoint> ReplayPoint::wallClock(std::string_view text)
{
    ReplayPoint point;
    point._kind = Kind::TimeOfDay;
    Scanner scanner(text);
    if (text.find('-') == 4) {
        const auto day = takeDay(scanner);
        if (!day)
            return std::nullopt;
        point._kind = Kind::DayAndTime;
        point._day = *day;
    }
    point._time = takeTime(scanner);
    if (!scanner.isAtEnd())
        point._zone = takeZone(scanner);
    if (!scanner.isAtEnd())
        return std::nullopt;
    return point;
}

/// The point's time on that day of its zone. The device's offset is the one in force then, but for the hour around a
/// change of it.
Moment ReplayPoint::universal(std::chrono::sys_days day, const Clock& clock) const
{
    const Moment local = day + _time;
    if (_zone)
        return local - *_zone;
    const Moment guess = local - std::chrono::seconds(clock.zoneAt(local).secondsEastOfUTC);
    return local - std::chrono::seconds(clock.zoneAt(guess).secondsEastOfUTC);
}

Moment ReplayPoint::in(Moment first, const Clock& clock) const
{
    if (_kind == Kind::Offset)
        return first + _time;
    if (_kind == Kind::DayAndTime)
        return universal(_day, clock);
    // The recording starts on this day or, in another zone, on one of its neighbours.
    auto day = std::chrono::floor<std::chrono::days>(first) - std::chrono::days(1);
    while (universal(day, clock) < first)
        day += std::chrono::days(1);
    return universal(day, clock);
}

} // namespace spectrel
