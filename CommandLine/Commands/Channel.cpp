#include "CommandLine/Commands/Channel.h"

#include "Analysis/Bands/Bands.h"
#include "CommandLine/Program/ErrorLine.h"
#include "CommandLine/Program/ExitStatus.h"
#include "Values/JsonText.h"
#include "Values/Table.h"

#include <array>
#include <charconv>
#include <cstdio>
#include <vector>

namespace spectrel {

namespace {

struct TechnologyRow {
    std::string_view name;
    ChannelTechnology technology;
    std::string_view title; // for people
    std::string_view bandTitle; // what stands before a band's name
    std::vector<ChannelNumbering> (*numberings)();
};

constexpr std::array<TechnologyRow, 4> Technologies {{
    {"lte", ChannelTechnology::LTE, "LTE", "band ", [] { return std::vector {ChannelNumbering::EUTRA}; }},
    {"utran", ChannelTechnology::UTRAN, "UTRAN", "band ",
        [] {
            return std::vector {ChannelNumbering::UTRAFDD, ChannelNumbering::UTRATDD};
        }},
    {"gsm", ChannelTechnology::GSM, "GSM", "", [] { return std::vector {ChannelNumbering::GSM}; }},
    {"cdma", ChannelTechnology::CDMA, "CDMA", "band class ", [] { return std::vector {ChannelNumbering::CDMA}; }},
}};

const TechnologyRow& rowOf(ChannelTechnology technology)
{
    return *findRow(Technologies, technology, &TechnologyRow::technology);
}

/// The shortest number that reads back as the same, with a decimal at least.
std::string numberText(double number)
{
    std::array<char, 32> text {};
    const auto written = std::to_chars(text.begin(), text.end(), number, std::chars_format::fixed);
    std::string shown(text.begin(), written.ptr);
    return shown.find('.') == std::string::npos ? shown + ".0" : shown;
}

std::vector<BandChannel> channelsFor(const ChannelOptions& options)
{
    std::vector<BandChannel> channels;
    for (const ChannelNumbering numbering : rowOf(options.technology).numberings()) {
        const auto found = options.number ? bandsOfChannel(numbering, *options.number, options.band)
                                          : channelsAtMHz(numbering, options.mhz.value_or(0), options.band);
        channels.insert(channels.end(), found.begin(), found.end());
    }
    return channels;
}

void appendTextMember(std::string_view key, std::string_view text, std::string& out)
{
    out += ", \"" + std::string(key) + "\": ";
    appendJsonText(text, out);
}

void appendNumberMember(std::string_view key, const std::string& number, std::string& out)
{
    out += ", \"" + std::string(key) + "\": " + number;
}

std::string bandJson(const BandChannel& channel)
{
    std::string out = "{\"band\": ";
    appendJsonText(channel.band, out);
    appendTextMember("name", channel.name, out);
    appendTextMember("direction", directionName(channel.direction), out);
    appendNumberMember("downlinkMHz", numberText(channel.downlinkMHz), out);
    if (channel.uplinkMHz)
        appendNumberMember("uplinkMHz", numberText(*channel.uplinkMHz), out);
    appendNumberMember("downlinkChannel", std::to_string(channel.downlinkChannel), out);
    if (channel.uplinkChannel)
        appendNumberMember("uplinkChannel", std::to_string(*channel.uplinkChannel), out);
    appendTextMember("duplex", duplexName(channel.duplex), out);
    return out + "}";
}

std::string json(const ChannelOptions& options, const std::vector<BandChannel>& channels)
{
    std::string out = "{\"technology\": ";
    appendJsonText(rowOf(options.technology).name, out);
    if (options.number)
        appendNumberMember("channel", std::to_string(*options.number), out);
    else
        appendNumberMember("MHz", numberText(options.mhz.value_or(0)), out);
    out += ", \"bands\": [";
    for (const BandChannel& channel : channels)
        out += (&channel == channels.data() ? "" : ", ") + bandJson(channel);
    return out + "]}\n";
}

std::string pairText(const BandChannel& channel)
{
    const std::string down = std::to_string(channel.downlinkChannel) + " = " + numberText(channel.downlinkMHz) + " MHz";
    if (!channel.uplinkChannel || !channel.uplinkMHz)
        return "downlink " + down + " without uplink";
    if (channel.duplex == Duplex::TDD)
        return down + " both ways";
    const std::string upMHz = numberText(*channel.uplinkMHz) + " MHz";
    if (*channel.uplinkChannel == channel.downlinkChannel)
        return down + " downlink, " + upMHz + " uplink";
    const std::string up = std::to_string(*channel.uplinkChannel) + " = " + upMHz;
    return channel.direction == ChannelDirection::Uplink ? "uplink " + up + " with downlink " + down
                                                         : "downlink " + down + " with uplink " + up;
}

std::string text(const ChannelOptions& options, const std::vector<BandChannel>& channels)
{
    const TechnologyRow& row = rowOf(options.technology);
    std::string out;
    for (const BandChannel& channel : channels) {
        out += std::string(row.title) + " " + std::string(row.bandTitle) + std::string(channel.band) + ", "
            + std::string(channel.name) + ", " + std::string(duplexName(channel.duplex)) + ": " + pairText(channel)
            + "\n";
    }
    return out;
}

/// What was asked for and is in no band.
std::string complaint(const ChannelOptions& options)
{
    const std::string title(rowOf(options.technology).title);
    const std::string where = options.band ? " in band '" + *options.band + "'" : "";
    const std::string asked = options.number ? "channel " + std::to_string(*options.number)
                                             : "channel at " + numberText(options.mhz.value_or(0)) + " MHz";
    return title + " has no " + asked + where;
}

} // namespace

std::optional<ChannelTechnology> channelTechnologyNamed(std::string_view name)
{
    const auto* row = findRow(Technologies, name, &TechnologyRow::name);
    return row ? std::optional(row->technology) : std::nullopt;
}

std::optional<ChannelFormat> channelFormatNamed(std::string_view name)
{
    if (name == "text")
        return ChannelFormat::Text;
    return name == "json" ? std::optional(ChannelFormat::Json) : std::nullopt;
}

int channel(const ChannelOptions& options)
{
    const auto channels = channelsFor(options);
    const std::string out = options.format == ChannelFormat::Json ? json(options, channels) : text(options, channels);
    if (std::fwrite(out.data(), 1, out.size(), stdout) != out.size() || std::fflush(stdout) != 0) {
        report("standard output: cannot be written");
        return ExitStatus::Failed;
    }
    if (channels.empty()) {
        report(complaint(options));
        return ExitStatus::Failed;
    }
    return ExitStatus::Done;
}

} // namespace spectrel
