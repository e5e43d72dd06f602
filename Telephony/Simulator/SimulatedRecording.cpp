#include "Telephony/Simulator/SimulatedRecording.h"

namespace spectrel {

Outcome writeSimulatedRecording(
    Baseband& baseband, const std::string& path, std::chrono::milliseconds duration, const MoveHandler& onMove)
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
    const auto report = [&] {
        for (const Move& move : baseband.moves()) {
            if (onMove)
                onMove(now, move);
        }
    };
    baseband.greet(now, write);
    report();
    while (written && now + Baseband::Step <= SimulatedRecordingStart + duration) {
        now += Baseband::Step;
        baseband.advance(now, write);
        report();
    }
    return written ? writer.flush() : written;
}

} // namespace spectrel
