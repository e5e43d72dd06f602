#include "Telephony/Simulator/SimulatedRecording.h"

namespace spectrel {

Outcome writeSimulatedRecording(Baseband& baseband, const std::string& path, std::chrono::milliseconds duration)
{
    const auto created = createRecording(path, baseband.technology());
    if (!created)
        return created.failure();
    RecordingWriter& writer = **created;
    Outcome written = Done();
    Moment now = SimulatedRecordingStart;
    const auto write = [&](ByteView record) {
        if (written)
            written = writer.write(now, record);
    };
    baseband.greet(now, write);
    while (written && now + Baseband::Step <= SimulatedRecordingStart + duration) {
        now += Baseband::Step;
        baseband.advance(now, write);
    }
    return written ? writer.flush() : written;
}

} // namespace spectrel
