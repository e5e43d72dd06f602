#include "Analysis/Bands/Bands.h"

#include "Analysis/Bands/ChannelRange.h"

#include <array>
#include <cmath>
#include <cstddef>
#include <span>

namespace spectrel {

namespace {

using Place = std::optional<std::uint32_t>; // a channel's place in its range, from 0

std::span<const ChannelRange> rangesOf(ChannelNumbering numbering)
{
    switch (numbering) {
    case ChannelNumbering::EUTRA:
        return eutraRanges();
    case ChannelNumbering::UTRAFDD:
        return utraFDDRanges();
    case ChannelNumbering::UTRATDD:
        return utraTDDRanges();
    case ChannelNumbering::GSM:
        return gsmRanges();
    case ChannelNumbering::CDMA:
        return cdmaRanges();
    }
    return {};
}

double mhzOf(Hertz frequency)
{
    return static_cast<double>(frequency) / 1e6;
}

/// The place of a number in one direction of a range.
Place placeOf(const ChannelRange& range, const ChannelRange::Side& side, std::uint32_t channel)
{
    if (channel < side.first)
        return std::nullopt;
    const std::uint32_t above = channel - side.first;
    return above % range.step == 0 && above / range.step < side.count ? Place(above / range.step) : std::nullopt;
}

/// The place of a frequency.
Place placeOf(const ChannelRange& range, const ChannelRange::Side& side, Hertz frequency)
{
    const Hertz above = frequency - side.firstFrequency;
    if (above < 0 || above % range.spacing != 0 || above / range.spacing >= side.count)
        return std::nullopt;
    return static_cast<std::uint32_t>(above / range.spacing);
}

std::uint32_t channelAt(const ChannelRange& range, const ChannelRange::Side& side, std::uint32_t place)
{
    return side.first + place * range.step;
}

double mhzAt(const ChannelRange& range, const ChannelRange::Side& side, std::uint32_t place)
{
    return mhzOf(side.firstFrequency + place * range.spacing);
}

BandChannel channelOf(
    ChannelNumbering numbering, const ChannelRange& range, std::uint32_t place, ChannelDirection direction)
{
    BandChannel channel {numbering, range.band, range.name, range.duplex, direction,
        channelAt(range, range.downlink, place), mhzAt(range, range.downlink, place), std::nullopt, std::nullopt};
    if (place < range.uplink.count) {
        channel.uplinkChannel = channelAt(range, range.uplink, place);
        channel.uplinkMHz = mhzAt(range, range.uplink, place);
    }
    return channel;
}

/// Every channel with this number or frequency.
template <typename Wanted>
std::vector<BandChannel> channelsWith(ChannelNumbering numbering, Wanted wanted, std::optional<std::string_view> band)
{
    std::vector<BandChannel> channels;
    for (const ChannelRange& range : rangesOf(numbering)) {
        if (band && range.band != *band)
            continue;
        const Place down = placeOf(range, range.downlink, wanted);
        const Place up = placeOf(range, range.uplink, wanted);
        if (down && down == up) {
            channels.push_back(channelOf(numbering, range, *down, ChannelDirection::Both));
            continue;
        }
        if (down)
            channels.push_back(channelOf(numbering, range, *down, ChannelDirection::Downlink));
        if (up)
            channels.push_back(channelOf(numbering, range, *up, ChannelDirection::Uplink));
    }
    return channels;
}

/// A value on which all bands agree so far.
template <typename Value> void keepIfEqual(Value& kept, const Value& other)
{
    if (kept != other)
        kept = Value();
}

} // namespace

std::string_view duplexName(Duplex duplex)
{
    constexpr std::array<std::string_view, 3> Names {"FDD", "TDD", "SDL"};
    return Names[static_cast<std::size_t>(duplex)];
}

std::string_view directionName(ChannelDirection direction)
{
    constexpr std::array<std::string_view, 3> Names {"downlink", "uplink", "both"};
    return Names[static_cast<std::size_t>(direction)];
}

std::vector<BandChannel> bandsOfChannel(
    ChannelNumbering numbering, std::uint32_t channel, std::optional<std::string_view> band)
{
    return channelsWith(numbering, channel, band);
}

std::vector<BandChannel> channelsAtMHz(ChannelNumbering numbering, double mhz, std::optional<std::string_view> band)
{
    constexpr double LimitMHz = 1e6; // far above every band, and whole hertz still fit
    if (!(mhz >= 0 && mhz <= LimitMHz))
        return {};
    return channelsWith(numbering, static_cast<Hertz>(std::llround(mhz * 1e6)), band);
}

DownlinkChannel findDownlinkChannel(
    ChannelNumbering numbering, std::uint32_t channel, std::optional<std::string_view> hint)
{
    std::optional<DownlinkChannel> found;
    for (const ChannelRange& range : rangesOf(numbering)) {
        if (hint && range.band != *hint)
            continue;
        const Place place = placeOf(range, range.downlink, channel);
        if (!place)
            continue;
        const BandChannel one = channelOf(numbering, range, *place, ChannelDirection::Downlink);
        const DownlinkChannel known {one.band, one.downlinkMHz, one.uplinkMHz, one.duplex};
        if (!found) {
            found = known;
            continue;
        }
        keepIfEqual(found->band, known.band);
        keepIfEqual(found->downlinkMHz, known.downlinkMHz);
        keepIfEqual(found->uplinkMHz, known.uplinkMHz);
        keepIfEqual(found->duplex, known.duplex);
    }
    return found.value_or(DownlinkChannel {});
}

} // namespace spectrel
