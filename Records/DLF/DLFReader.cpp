#include "Records/DLF/DLFReader.h"

#include "Records/Frame.h"
#include "Records/MessageCutter.h"

#include <algorithm>

namespace spectrel {

namespace {

constexpr std::size_t LongestFirstItem = 8191; // of a file without version report: rules text and most other files out
constexpr unsigned VersionReportCode = 0x1FFD;
constexpr std::size_t TimeOfWriting = 81; // in the version report: seconds since 1970, 32 bits

class DLFReader final : public RecordingReader {
public:
    explicit DLFReader(Bytes bytes);

    std::optional<Technology> technology() const override
    {
        return std::nullopt;
    }
    bool next(RecordedMessage& message) override;
    const std::string& damage() const override
    {
        return _damage;
    }

private:
    Bytes _bytes;
    std::size_t _start = 0; // behind the version report
    Moment _time; // of writing
    MessageCutter _cutter;
    std::size_t _count = 0; // of messages read
    Bytes _restored; // a message whose first byte the file does not hold
    std::string _damage;
};

DLFReader::DLFReader(Bytes bytes)
    : _bytes(std::move(bytes))
    , _start(startsWithVersionReport(_bytes) ? itemLength(ByteView(_bytes), 0) : 0)
    , _cutter(ByteView(_bytes).subspan(std::min(_start, _bytes.size())), MessageSequence::Beheaded)
{
    if (_start > _bytes.size())
        _damage = "version report at byte 0: it has a length of " + std::to_string(_start) + ", "
            + std::to_string(_bytes.size()) + " bytes are left";
    else
        _time = timeOfVersionReport(ByteView(_bytes).first(_start));
}

bool DLFReader::next(RecordedMessage& message)
{
    MessageCutter::Cut cut;
    if (!_damage.empty())
        return false;
    if (!_cutter.next(cut)) {
        const std::size_t place = _start + _cutter.place();
        if (place < _bytes.size())
            _damage =
                "message " + std::to_string(_count) + " at byte " + std::to_string(place) + ": " + _cutter.complaint();
        return false;
    }
    message.time = _time;
    message.body = ByteView(_bytes).subspan(_start + cut.start, cut.length);
    if (cut.missingByte) {
        _restored.assign(1, *cut.missingByte);
        _restored.insert(_restored.end(), message.body.begin(), message.body.end());
        message.body = _restored;
    }
    ++_count;
    return true;
}

} // namespace

bool startsWithVersionReport(ByteView bytes)
{
    return itemLength(bytes, 0) >= ItemHeaderSize && itemCode(bytes, 0) == VersionReportCode;
}

Moment timeOfVersionReport(ByteView report)
{
    if (report.size() < TimeOfWriting + 4)
        return {};
    return Moment(std::chrono::seconds(RecordView(report).u32(TimeOfWriting)));
}

bool looksLikeDLF(ByteView bytes)
{
    const std::size_t length = itemLength(bytes, 0);
    return startsWithVersionReport(bytes)
        || (length >= ItemHeaderSize && length <= LongestFirstItem && length <= bytes.size());
}

std::unique_ptr<RecordingReader> openDLF(Bytes bytes)
{
    return std::make_unique<DLFReader>(std::move(bytes));
}

} // namespace spectrel
