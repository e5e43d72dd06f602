// A live stream of any bytes. The first byte says in pieces of what length it comes; cut up or whole, it yields the
// same.
#include "Records/RecordingStream.h"

#include <algorithm>
#include <cstdlib>

namespace {

using namespace spectrel;

enum class Settling : std::uint8_t { Never, AfterEachPiece };

/// Every step and every byte that the stream yields, and that it yields no more bytes than it was given.
Bytes readInPieces(ByteView bytes, std::size_t length, Settling settling)
{
    const auto stream = makeRecordingStream(Technology::LTE);
    Bytes yielded;
    std::size_t accounted = 0;
    const auto takeAll = [&] {
        RecordedMessage message;
        for (StreamStep step = StreamStep::Begin; step != StreamStep::Waiting && step != StreamStep::Refused;) {
            step = stream->next(message);
            if (step == StreamStep::Waiting)
                break;
            yielded.push_back(static_cast<std::uint8_t>(step));
            if (step == StreamStep::Message) {
                yielded.insert(yielded.end(), message.body.begin(), message.body.end());
                accounted += message.body.size() - 1; // one byte may have been restored
            } else if (step == StreamStep::Skipped) {
                accounted += stream->skipped().length;
                yielded.push_back(static_cast<std::uint8_t>(stream->skipped().length));
            }
        }
        return stream->reason().empty();
    };
    bool goesOn = true;
    for (std::size_t place = 0; goesOn && place < bytes.size(); place += length) {
        stream->append(bytes.subspan(place, std::min(length, bytes.size() - place)));
        goesOn = takeAll();
        if (goesOn && settling == Settling::AfterEachPiece) {
            stream->settle();
            goesOn = takeAll();
        }
    }
    stream->finish();
    if (goesOn)
        takeAll();
    if (accounted > bytes.size())
        std::abort();
    return yielded;
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* bytes, std::size_t size)
{
    if (size < 1 || size > 1 << 16)
        return 0;
    const std::size_t length = 1 + bytes[0];
    const ByteView stream(bytes + 1, size - 1);
    if (readInPieces(stream, RecordingStream::LargestAppend, Settling::Never)
        != readInPieces(stream, length, Settling::Never))
        std::abort();
    if (size < 1 << 12)
        readInPieces(stream, length, Settling::AfterEachPiece);
    return 0;
}
