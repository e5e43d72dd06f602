#include "Records/Capture/CaptureFormat.h"
#include "Records/Capture/CaptureOutput.h"
#include "Records/Recording.h"
#include "Values/Bytes.h"

#include <algorithm>
#include <cstdio>
#include <limits>
#include <optional>
#include <pcap/pcap.h>
#include <utility>

namespace spectrel {

namespace {

static_assert(LargestMessage == 262144, "the largest packet that libpcap reads back");

struct CaptureCloser {
    void operator()(pcap_t* capture) const
    {
        pcap_close(capture);
    }
    void operator()(pcap_dumper_t* dumper) const
    {
        pcap_dump_close(dumper);
    }
};
using Capture = std::unique_ptr<pcap_t, CaptureCloser>;
using Dumper = std::unique_ptr<pcap_dumper_t, CaptureCloser>;

/// What gathers before it is written without being asked. Only whole packets reach the file, so that a program that is
/// killed leaves a file that ends with one, unless it is killed in the midst of a write, which the system breaks off
/// between two pages.
constexpr std::size_t WriteSize = 512 * 1024;
static_assert(RecordingWriter::MostWaiting > WriteSize + LargestMessage + PacketHeaderSize);

ssize_t gather(void* gathered, const char* bytes, std::size_t length)
{
    auto& all = *static_cast<Bytes*>(gathered);
    all.insert(all.end(), bytes, bytes + length);
    return static_cast<ssize_t>(length);
}

class CaptureWriter final : public RecordingWriter {
public:
    explicit CaptureWriter(RecordingOutput append)
        : _append(std::move(append))
    {
    }
    ~CaptureWriter() override
    {
        [[maybe_unused]] const auto flushed = flush();
    }
    /// Gathers the head.
    Outcome begin(Technology technology);
    void adopt(CaptureOutput file)
    {
        _file.emplace(std::move(file));
    }
    Outcome publish()
    {
        return _file->publish();
    }

    Outcome write(Moment time, ByteView body) override;
    Outcome flush() override;
    std::uint64_t waiting() const override
    {
        return _waiting;
    }
    int descriptor() const override
    {
        return _file ? _file->descriptor() : -1;
    }

private:
    RecordingOutput _append; // where there is no file
    std::optional<CaptureOutput> _file;
    Bytes _gathered; // whole packets
    std::uint64_t _waiting = 0; // messages in them
    Dumper _dumper; // writes what is gathered
    std::optional<Failure> _broken; // nothing may follow
};

Outcome CaptureWriter::begin(Technology technology)
{
    std::FILE* const stream = ::fopencookie(&_gathered, "wb", {nullptr, gather, nullptr, nullptr});
    if (!stream)
        return Failure::ofSystem();
    std::setvbuf(stream, nullptr, _IONBF, 0);
    const auto link = std::ranges::find(LinkTypes, technology, &LinkType::technology);
    const Capture capture(pcap_open_dead(link->number, LargestMessage));
    _dumper.reset(pcap_dump_fopen(capture.get(), stream)); // closes the stream when it fails
    return _dumper ? Outcome(Done()) : Failure {pcap_geterr(capture.get())};
}

Outcome CaptureWriter::write(Moment time, ByteView body)
{
    if (_broken)
        return *_broken;
    if (body.empty() || body.size() > LargestMessage)
        return Failure {"a message has 1 to " + std::to_string(LargestMessage) + " bytes, this one has "
            + std::to_string(body.size())};
    const auto second = std::chrono::floor<std::chrono::seconds>(time);
    const std::int64_t seconds = second.time_since_epoch().count();
    if (seconds < 0 || seconds > std::numeric_limits<std::uint32_t>::max())
        return Failure {"the time " + defaultDateForm(time) + " is outside what a capture can tell"};
    const std::size_t length = PacketHeaderSize + body.size();
    if (_gathered.size() + length > WriteSize) {
        const auto flushed = flush();
        if (!flushed && (_broken || _gathered.size() + length > MostWaiting))
            return flushed;
    }
    pcap_pkthdr header {};
    header.ts.tv_sec = seconds;
    header.ts.tv_usec = (time - second).count();
    header.caplen = static_cast<std::uint32_t>(body.size());
    header.len = header.caplen;
    pcap_dump(reinterpret_cast<std::uint8_t*>(_dumper.get()), &header, body.data());
    ++_waiting;
    return Done();
}

Outcome CaptureWriter::flush()
{
    if (_broken)
        return *_broken;
    if (_gathered.empty())
        return Done();
    const auto written = _file ? _file->append(_gathered) : _append(_gathered);
    if (!written) {
        if (written.failure().code != Failure::Code::NoRoom)
            _broken = written.failure();
        return written;
    }
    _gathered.clear();
    _waiting = 0;
    return Done();
}

Result<std::unique_ptr<RecordingWriter>> create(const std::string& path, Technology technology, IfThere ifThere)
{
    auto output = CaptureOutput::open(path, ifThere);
    if (!output)
        return output.failure();
    auto writer = std::make_unique<CaptureWriter>(RecordingOutput());
    writer->adopt(*std::move(output));
    if (const auto begun = writer->begin(technology); !begun)
        return begun.failure();
    if (const auto flushed = writer->flush(); !flushed) // the head stands in the file from the start
        return flushed.failure();
    if (const auto published = writer->publish(); !published)
        return published.failure();
    return writer;
}

} // namespace

Result<std::unique_ptr<RecordingWriter>> createRecording(const std::string& path, Technology technology)
{
    return create(path, technology, IfThere::Overwrite);
}

Result<std::unique_ptr<RecordingWriter>> createNewRecording(const std::string& path, Technology technology)
{
    return create(path, technology, IfThere::Refuse);
}

Result<std::unique_ptr<RecordingWriter>> createRecordingOn(RecordingOutput output, Technology technology)
{
    auto writer = std::make_unique<CaptureWriter>(std::move(output));
    if (const auto begun = writer->begin(technology); !begun)
        return begun.failure();
    if (const auto flushed = writer->flush(); !flushed)
        return flushed.failure();
    return writer;
}

} // namespace spectrel
