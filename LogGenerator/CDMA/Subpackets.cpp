#include "LogGenerator/CDMA/Subpackets.h"

#include "Platform/SystemLog.h"

namespace spectrel {

namespace {
constexpr std::size_t Count = 14;
} // namespace

std::optional<std::size_t> findSubpacket(SystemLog& log, RecordView record, std::uint8_t id)
{
    // The bytes before the subpackets count twice, on purpose: a subpacket may reach that far past the record's end.
    const std::size_t bound = SubpacketsStart + record.size();
    const int count = record.u8(Count);
    std::size_t place = SubpacketsStart;
    for (int passed = 0; passed < count; ++passed) {
        const std::uint16_t size = record.u16(place + 2);
        if (place + size >= bound) {
            SPECTREL_LOG(log, Priority::Error, "Log code error in subpkt#%d: bad size (%d).", passed, size);
            return std::nullopt;
        }
        if (record.u8(place) == id)
            return place;
        place += size;
    }
    return std::nullopt;
}

} // namespace spectrel
