#include "Records/Capture/CaptureFormat.h"
#include "Records/Capture/CaptureOutput.h"
#include "Records/Recording.h"
#include "Values/Bytes.h"

#include <algorithm>
#include <cerrno>
#include <cstdio>
#include <limits>
#include <optional>
#include <pcap/pcap.h>

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

/// Of the file's buffer. Only whole packets leave it, so that a program that is killed leaves a file that ends with
/// one, unless it is killed in the midst of a write, which the system breaks off between two pages.
constexpr std::size_t BufferSize = 512 * 1024;
static_assert(BufferSize > LargestMessage + PacketHeaderSize);

class CaptureWriter final : public RecordingWriter {
public:
    CaptureWriter(std::unique_ptr<char[]> buffer, Dumper dumper)
        : _buffer(std::move(buffer))
        , _dumper(std::move(dumper))
    {
    }
    Outcome write(Moment time, ByteView body) override;
    Outcome flush() override;

private:
    Outcome doneUnless(bool isBroken);

    std::unique_ptr<char[]> _buffer; // the file's, so that it ends after it
    Dumper _dumper;
    std::size_t _buffered = 0; // bytes since the last flush
    std::optional<Failure> _broken; // the file holds a part of a packet, perhaps; nothing may follow
};

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
    pcap_pkthdr header {};
    header.ts.tv_sec = seconds;
    header.ts.tv_usec = (time - second).count();
    header.caplen = static_cast<std::uint32_t>(body.size());
    header.len = header.caplen;
    const std::size_t length = PacketHeaderSize + body.size();
    if (_buffered + length > BufferSize) {
        if (auto flushed = flush(); !flushed)
            return flushed;
    }
    _buffered += length;
    errno = 0;
    pcap_dump(reinterpret_cast<std::uint8_t*>(_dumper.get()), &header, body.data());
    return doneUnless(std::ferror(pcap_dump_file(_dumper.get())) != 0);
}

Outcome CaptureWriter::flush()
{
    if (_broken)
        return *_broken;
    _buffered = 0;
    return doneUnless(pcap_dump_flush(_dumper.get()) != 0);
}

Outcome CaptureWriter::doneUnless(bool isBroken)
{
    if (!isBroken)
        return Done();
    _broken = Failure::ofSystem();
    return *_broken;
}

Result<std::unique_ptr<RecordingWriter>> create(
    const std::string& path, Technology technology, CaptureOutput::IfThere ifThere)
{
    auto output = CaptureOutput::open(path, ifThere);
    if (!output)
        return output.failure();
    auto buffer = std::make_unique_for_overwrite<char[]>(BufferSize);
    std::setvbuf(output->stream(), buffer.get(), _IOFBF, BufferSize);
    const auto link = std::ranges::find(LinkTypes, technology, &LinkType::technology);
    const Capture capture(pcap_open_dead(link->number, LargestMessage));
    Dumper dumper(pcap_dump_fopen(capture.get(), output->stream())); // closes the file when it fails
    if (!dumper)
        return Failure {pcap_geterr(capture.get())};
    auto writer = std::make_unique<CaptureWriter>(std::move(buffer), std::move(dumper));
    if (const auto flushed = writer->flush(); !flushed) // the head stands in the file from the start
        return flushed.failure();
    if (const auto published = output->publish(); !published)
        return published.failure();
    return writer;
}

} // namespace

Result<std::unique_ptr<RecordingWriter>> createRecording(const std::string& path, Technology technology)
{
    return create(path, technology, CaptureOutput::IfThere::Overwrite);
}

Result<std::unique_ptr<RecordingWriter>> createNewRecording(const std::string& path, Technology technology)
{
    return create(path, technology, CaptureOutput::IfThere::Refuse);
}

} // namespace spectrel
