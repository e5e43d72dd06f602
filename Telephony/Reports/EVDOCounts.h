#pragma once

#include <array>
#include <cstddef>
#include <cstdint>

namespace spectrel {

/// A transmission format of the EV-DO forward link (3GPP2 C.S0024-A, forward traffic channel).
struct ForwardFormat {
    std::uint8_t drc; // index of the data rate that the phone asks for, 0 to 14
    std::uint16_t bits; // in a packet
    std::uint8_t slots; // of 5/3 ms that a packet takes
    double signal; // SINR in dB that it needs
};

constexpr std::size_t ForwardRates = 15;

/// By data rate, then by packet size.
constexpr std::array<ForwardFormat, 41> ForwardFormats {{
    {0, 128, 16, -15},
    {0, 256, 16, -15},
    {0, 512, 16, -15},
    {0, 1024, 16, -15},
    {1, 128, 16, -12.5},
    {1, 256, 16, -12.5},
    {1, 512, 16, -12.5},
    {1, 1024, 16, -12.5},
    {2, 128, 8, -9.5},
    {2, 256, 8, -9.5},
    {2, 512, 8, -9.5},
    {2, 1024, 8, -9.5},
    {3, 128, 4, -6.5},
    {3, 256, 4, -6.5},
    {3, 512, 4, -6.5},
    {3, 1024, 4, -6.5},
    {4, 128, 2, -4},
    {4, 256, 2, -4},
    {4, 512, 2, -4},
    {4, 1024, 2, -4},
    {5, 512, 4, -3.5},
    {5, 1024, 4, -3.5},
    {5, 2048, 4, -3.5},
    {6, 128, 1, -1},
    {6, 256, 1, -1},
    {6, 512, 1, -1},
    {6, 1024, 1, -1},
    {7, 512, 2, -0.5},
    {7, 1024, 2, -0.5},
    {7, 2048, 2, -0.5},
    {8, 1024, 2, 1.5},
    {8, 3072, 2, 1.5},
    {9, 512, 1, 3},
    {9, 1024, 1, 3},
    {9, 2048, 1, 3},
    {10, 4096, 2, 3.5},
    {11, 1024, 1, 7},
    {11, 3072, 1, 7},
    {12, 4096, 1, 9.5},
    {13, 5120, 2, 6},
    {14, 5120, 1, 11},
}};

/// Bits of the reverse link's packets, smallest first (3GPP2 C.S0024-A, subtype 3 reverse traffic channel).
constexpr std::array<std::uint16_t, 12> ReversePayloads {
    128, 256, 512, 768, 1024, 1536, 2048, 3072, 4096, 6144, 8192, 12288};

/// Packets of one payload on one interlace in one transmission mode.
struct ReversePackets {
    std::array<std::uint32_t, 4> arrived {}; // by the subpacket that ended them
    std::uint32_t lost = 0;
};

/// What an EV-DO session has carried since it began, packet by packet.
struct EVDOCounts {
    static constexpr std::size_t Interlaces = 3;
    static constexpr std::size_t Modes = 2; // high capacity, low latency
    using ReverseInterlace = std::array<std::array<ReversePackets, ReversePayloads.size()>, Modes>;

    std::array<std::uint32_t, ForwardFormats.size()> forward {};
    std::array<std::uint32_t, ForwardRates> forwardLost {}; // packets that did not arrive whole, by data rate
    std::array<ReverseInterlace, Interlaces> reverse {}; // by interlace, mode and payload
    std::uint64_t forwardBits = 0;
    std::uint64_t reverseBits = 0;
};

} // namespace spectrel
