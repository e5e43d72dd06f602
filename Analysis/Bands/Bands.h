#pragma once

#include <cstdint>
#include <optional>
#include <string_view>
#include <vector>

namespace spectrel {

/// Who numbers the channels.
enum class ChannelNumbering : std::uint8_t {
    EUTRA, // E-ARFCN, 3GPP TS 36.101 (Release 16)
    UTRAFDD, // UARFCN, 3GPP TS 25.101 (Release 16), with the additional channels
    UTRATDD, // UARFCN, 3GPP TS 25.102
    GSM, // ARFCN, 3GPP TS 45.005
    CDMA, // channel number within a band class, 3GPP2 C.S0057
};

enum class Duplex : std::uint8_t {
    FDD, // a pair of frequencies
    TDD, // one frequency in turns
    SDL, // supplemental downlink: no uplink in this band
};

/// "FDD", "TDD", "SDL".
std::string_view duplexName(Duplex duplex);

/// Which way a channel number serves; one number may serve both (GSM, CDMA, TDD).
enum class ChannelDirection : std::uint8_t { Downlink, Uplink, Both };

/// "downlink", "uplink", "both".
std::string_view directionName(ChannelDirection direction);

/// A channel number as a channel of one band, with its pair.
struct BandChannel {
    ChannelNumbering numbering;
    std::string_view band; // "3", "DCS 1800"; unique within the numbering
    std::string_view name; // what people call it: "1800 MHz"
    Duplex duplex;
    ChannelDirection direction; // which way the channel or frequency that was asked for serves
    std::uint32_t downlinkChannel;
    double downlinkMHz; // centre frequency
    std::optional<std::uint32_t> uplinkChannel; // none for a downlink channel without a pair
    std::optional<double> uplinkMHz; // as `uplinkChannel`; TDD: the downlink's
};

/// Every band in which this is the number of a downlink or uplink channel, in the order of the standard's table; with a
/// band, only that one. Empty when no band has it.
std::vector<BandChannel> bandsOfChannel(
    ChannelNumbering numbering, std::uint32_t channel, std::optional<std::string_view> band = std::nullopt);

/// Every channel whose downlink or uplink centre frequency this is, in the same order. Frequencies are compared in
/// whole hertz; one that lies between channels has none.
std::vector<BandChannel> channelsAtMHz(
    ChannelNumbering numbering, double mhz, std::optional<std::string_view> band = std::nullopt);

/// What a downlink channel number alone tells: each value is known where every band that has the channel agrees.
struct DownlinkChannel {
    std::string_view band; // empty where no band has the channel, or several
    std::optional<double> downlinkMHz;
    std::optional<double> uplinkMHz; // none for a channel without a pair
    std::optional<Duplex> duplex;
};

/// Looks a downlink channel up without allocating. A hint is the band that somebody names, such as the cell's own
/// system information; nothing is known of a channel that the named band does not have.
DownlinkChannel findDownlinkChannel(
    ChannelNumbering numbering, std::uint32_t channel, std::optional<std::string_view> hint = std::nullopt);

} // namespace spectrel
