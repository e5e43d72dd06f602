#include "Platform/Qt/QtClock.h"

#include <QDateTime>
#include <QTimeZone>

#include <chrono>
#include <utility>

namespace spectrel {

namespace {

QTimeZone zoneNamed(const std::string& name)
{
    const QTimeZone zone = name.empty() ? QTimeZone::systemTimeZone() : QTimeZone(QByteArray::fromStdString(name));
    return zone.isValid() ? zone : QTimeZone::utc();
}

QDateTime dateIn(const QTimeZone& zone, Moment moment)
{
    const auto sinceEpoch = std::chrono::floor<std::chrono::milliseconds>(moment.time_since_epoch());
    return QDateTime::fromMSecsSinceEpoch(sinceEpoch.count(), zone);
}

} // namespace

QtClock::QtClock(std::string zone)
    : _zone(std::move(zone))
{
}

Moment QtClock::now() const
{
    return std::chrono::time_point_cast<std::chrono::microseconds>(std::chrono::system_clock::now());
}

ZoneState QtClock::zoneAt(Moment moment) const
{
    const QTimeZone zone = zoneNamed(_zone);
    const QDateTime date = dateIn(zone, moment);
    return {date.offsetFromUtc(), zone.isDaylightTime(date)};
}

std::string QtClock::formatted(Moment moment, std::string_view pattern) const
{
    const auto text = QString::fromUtf8(pattern.data(), static_cast<qsizetype>(pattern.size()));
    return dateIn(zoneNamed(_zone), moment).toString(text).toStdString();
}

} // namespace spectrel
