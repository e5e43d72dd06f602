#pragma once

#include "Records/Recording.h"
#include "Values/Table.h"

#include <array>
#include <cstddef>
#include <optional>

namespace spectrel {

/// A classic capture (pcap): the file's header, then packets, each behind a header of its own.
constexpr std::size_t CaptureHeaderSize = 24;
constexpr std::size_t PacketHeaderSize = 16;

/// A capture's link type names the technology.
struct LinkType {
    int number; // one of the numbers that captures leave to private use
    Technology technology;
};

constexpr std::array<LinkType, 5> LinkTypes {{
    {147, Technology::IFX},
    {148, Technology::GSM},
    {149, Technology::CDMA},
    {150, Technology::LTE},
    {151, Technology::UTRAN},
}};

/// None for a number of another use.
constexpr std::optional<Technology> technologyOfLinkType(int number)
{
    const auto* type = findRow(LinkTypes, number, &LinkType::number);
    return type ? std::optional(type->technology) : std::nullopt;
}

} // namespace spectrel
