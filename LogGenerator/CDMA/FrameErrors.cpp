#include "LogGenerator/CDMA/Decoders.h"
#include "LogGenerator/CDMA/Subpackets.h"
#include "LogGenerator/CDMA/TrafficFER.h"
#include "Platform/SystemLog.h"

namespace spectrel {

namespace {
constexpr std::uint8_t TrafficDemodulation = 11; // subpacket
constexpr std::size_t FrameIsBad = 24; // in it
} // namespace

void decodeFrameErrors(SystemLog& log, RecordView record, Dictionary& state, const Value& lookup)
{
    if (record.size() < SubpacketsStart) {
        SPECTREL_LOG(log, Priority::Error, "Log code 0x119d is %d bytes long but must be at least %ld bytes.",
            static_cast<int>(record.size()), static_cast<long>(SubpacketsStart));
        return;
    }
    const auto demodulation = findSubpacket(log, record, TrafficDemodulation);
    if (!demodulation) {
        SPECTREL_LOG(log, Priority::Warning, "Log code 0x119d: missing traffic demod subpacket.");
        return;
    }
    updateTrafficFER(record.u8(*demodulation + FrameIsBad) != 0, state, lookup);
}

} // namespace spectrel
