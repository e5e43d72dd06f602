#include "Telephony/Simulator/SimulatedRecording.h"

namespace spectrel {

Outcome writeSimulatedRecording(Baseband& baseband, const std::string& path, std::chrono::milliseconds duration)
{
    const auto created = createRecording(path, baseband.technology());
    if (!created)
        return created.failure();
    RecordingWriter& writer = **created;
    bool isWritten = true;
    Moment now = SimulatedRecordingStart;
    const auto write = [&](ByteView record) { isWritten = isWritten && writer.write(now, record); };
    baseband.greet(now, write);
    while (isWritten && now + Baseband::Step <= SimulatedRecordingStart + duration) {
        now += Baseband::Step;
        baseband.advance(now, write);
    }
    if (!isWritten || !writer.flush())
        return Failure {writer.error()};
    return Done();
}

} // namespace spectrel
