#include "Telephony/Simulator/SimulatedRecording.h"

namespace spectrel {

bool writeSimulatedRecording(
    Baseband& baseband, const std::string& path, std::chrono::milliseconds duration, std::string& reason)
{
    const auto writer = createRecording(path, baseband.technology(), reason);
    if (!writer)
        return false;
    bool isWritten = true;
    Moment now = SimulatedRecordingStart;
    const auto write = [&](ByteView record) { isWritten = isWritten && writer->write(now, record); };
    baseband.greet(now, write);
    while (isWritten && now + Baseband::Step <= SimulatedRecordingStart + duration) {
        now += Baseband::Step;
        baseband.advance(now, write);
    }
    isWritten = isWritten && writer->flush();
    reason = writer->error();
    return isWritten;
}

} // namespace spectrel
