#include "Telephony/StatusReport.h"

#include "Telephony/ServiceLine.h"

#include <cstdio>

namespace spectrel {

namespace {

std::string counted(std::size_t count, const char* one, const char* several)
{
    return std::to_string(count) + " " + (count == 1 ? one : several);
}

std::string rateText(double rate)
{
    char text[32];
    std::snprintf(text, sizeof text, rate < 10 ? "%.1f" : "%.0f", rate);
    return std::string(text) + " messages/s";
}

std::string channelLine(const ChannelStatus& channel, double rate)
{
    std::string line = "  " + channel.name + " to " + channel.client + ": ";
    if (!channel.isStreaming)
        return line + "not started";
    line += channel.wish + ", " + rateText(rate) + ", " + std::to_string(channel.sent) + " sent";
    if (channel.notAskedFor > 0)
        line += ", " + std::to_string(channel.notAskedFor) + " not asked for";
    line += ", " + std::to_string(channel.waiting) + " queued";
    if (channel.lost > 0)
        line += ", " + std::to_string(channel.lost) + " lost";
    return line + (channel.isFull ? ", its client is busy" : "");
}

} // namespace

StatusReport::StatusReport(const Clock& clock, const TelephonyService& service, const LogSource& source)
    : _clock(clock)
    , _service(service)
    , _source(source)
{
}

double StatusReport::rate(const ChannelStatus& channel) const
{
    const auto found = _before.find(channel.name);
    const Counted before = found == _before.end() ? Counted {0, channel.started} : found->second;
    const std::chrono::duration<double> elapsed = _clock.steady() - before.time;
    return elapsed.count() > 0 ? static_cast<double>(channel.sent - before.sent) / elapsed.count() : 0;
}

std::string StatusReport::headline() const
{
    const auto channels = _service.status();
    double sum = 0;
    for (const ChannelStatus& channel : channels)
        sum += rate(channel);
    std::string line = _source.status() + "; " + counted(channels.size(), "client", "clients");
    return channels.empty() ? line : line + ", " + rateText(sum);
}

std::vector<std::string> StatusReport::lines()
{
    std::vector<std::string> lines {headline()};
    std::map<std::string, Counted> counts;
    for (const ChannelStatus& channel : _service.status()) {
        lines.push_back(channelLine(channel, rate(channel)));
        counts[channel.name] = {channel.sent, _clock.steady()};
    }
    _before = std::move(counts);
    return lines;
}

bool StatusReport::hasNews() const
{
    const auto channels = _service.status();
    if (channels.size() != _before.size())
        return true;
    for (const ChannelStatus& channel : channels) {
        const auto before = _before.find(channel.name);
        if (before == _before.end() || before->second.sent != channel.sent)
            return true;
    }
    return false;
}

RegularReport::RegularReport(RunLoop& runLoop, StatusReport& report, std::chrono::milliseconds interval)
    : _timer(runLoop.repeat(interval, [&report] {
        if (report.hasNews())
            printStatus(report);
    }))
{
}

void printStatus(StatusReport& report)
{
    for (const std::string& line : report.lines())
        printServiceLine(line);
}

} // namespace spectrel
