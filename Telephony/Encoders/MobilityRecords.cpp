#include "Telephony/Encoders/MobilityRecords.h"

#include "Telephony/Encoders/RecordWriter.h"

#include <algorithm>

namespace spectrel {

namespace {

constexpr std::uint8_t Filler = 0xF;
constexpr std::size_t EntryStride = 3;
constexpr std::size_t EntryDigits = 6;

template <typename Code> std::uint32_t code(Code value)
{
    return static_cast<std::uint32_t>(value);
}

/// The three bytes of a PLMN identity (3GPP TS 24.008, 10.5.1.3).
std::array<std::uint8_t, 3> packedDigits(const std::optional<PLMN>& network)
{
    if (!network)
        return {0xFF, 0xFF, 0xFF};
    const auto& [country, digits, isShort] = *network;
    const std::uint8_t third = isShort ? Filler : digits[2];
    const auto pair = [](unsigned low, unsigned high) { return static_cast<std::uint8_t>(high << 4 | low); };
    return {pair(country[0], country[1]), pair(country[2], third), pair(digits[0], digits[1])};
}

std::array<std::uint8_t, EntryDigits> entryDigits(const PLMN& network)
{
    const auto& [country, digits, isShort] = network;
    if (isShort)
        return {country[0], 0, country[1], digits[0], country[2], digits[1]};
    return {country[0], digits[0], country[1], digits[1], country[2], digits[2]};
}

/// The digits of as many networks as fit each other.
Bytes overlappingEntries(std::span<const PLMN> networks)
{
    Bytes digits;
    for (const PLMN& network : networks) {
        const auto entry = entryDigits(network);
        const std::size_t shared = digits.empty() ? 0 : EntryDigits - EntryStride;
        if (!std::equal(entry.begin(), entry.begin() + static_cast<std::ptrdiff_t>(shared),
                digits.end() - static_cast<std::ptrdiff_t>(shared)))
            break;
        digits.insert(digits.end(), entry.begin() + static_cast<std::ptrdiff_t>(shared), entry.end());
    }
    return digits;
}

} // namespace

Bytes mmStateRecord(const MMReport& report, Moment time)
{
    return RecordWriter(0x7131, time).u8(code(report.state)).u8(code(report.subState)).u8(code(report.status)).take();
}

Bytes gmmStateRecord(const GMMReport& report, Moment time)
{
    return RecordWriter(0x7130, time).u8(code(report.state)).u8(code(report.subState)).u8(code(report.status)).take();
}

Bytes registrationRecord(const RegistrationReport& report, Moment time)
{
    return RecordWriter(0x7132, time).u8(code(report.state)).u8(code(report.selection)).zeros(1).take();
}

Bytes servingNetworkRecord(const NetworkReport& report, Moment time)
{
    return RecordWriter(0x7135, time)
        .u8(report.operatingMode)
        .u8(code(report.service))
        .bytes(packedDigits(report.network))
        .u8(report.locationArea >> 8) // big-endian
        .u8(report.locationArea)
        .u8(report.routingArea)
        .zeros(11)
        .take();
}

Bytes equivalentNetworksRecord(std::span<const PLMN> networks, Moment time)
{
    const Bytes digits = overlappingEntries(networks);
    const std::size_t count = digits.empty() ? 0 : digits.size() / EntryStride - 1;
    return RecordWriter(0x7150, time).zeros(3).u8(static_cast<std::uint32_t>(count)).bytes(digits).take();
}

} // namespace spectrel
