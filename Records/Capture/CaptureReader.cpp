#include "Records/Capture/CaptureReader.h"

#include "Records/Capture/CaptureFormat.h"

#include <algorithm>
#include <array>
#include <cstdint>
#include <pcap/pcap.h>

namespace spectrel {

namespace {

constexpr std::uint32_t PcapngMagic = 0x0A0D0D0A; // the same in either byte order
constexpr std::array<std::uint32_t, 5> Magics {0xA1B2C3D4, 0xD4C3B2A1, 0xA1B23C4D, 0x4D3CB2A1, PcapngMagic};

std::uint32_t magicOf(ByteView bytes)
{
    std::uint32_t magic = 0;
    for (const std::uint8_t byte : bytes.first(std::min<std::size_t>(bytes.size(), 4)))
        magic = magic << 8 | byte;
    return magic;
}

struct CaptureCloser {
    void operator()(pcap_t* capture) const
    {
        pcap_close(capture);
    }
};
using Capture = std::unique_ptr<pcap_t, CaptureCloser>;

class CaptureReader final : public RecordingReader {
public:
    CaptureReader(Capture capture, bool isClassic)
        : _capture(std::move(capture))
        , _isClassic(isClassic)
    {
        _technology = technologyOfLinkType(pcap_datalink(_capture.get()));
        _place = _isClassic ? std::int64_t {CaptureHeaderSize} : currentPlace();
    }

    std::optional<Technology> technology() const override
    {
        return _technology;
    }
    bool next(RecordedMessage& message) override;
    const std::string& damage() const override
    {
        return _damage;
    }

private:
    bool damaged(const std::string& why);
    /// Where the file stands; without syscalls, and no place in pipes.
    std::int64_t currentPlace() const
    {
        return ::ftello(pcap_file(_capture.get()));
    }
    Moment timeOf(const pcap_pkthdr& header) const;

    Capture _capture;
    bool _isClassic;
    std::optional<Technology> _technology;
    std::uint64_t _count = 0; // of messages read
    std::int64_t _place = 0; // of the next packet's header
    std::string _damage;
};

bool CaptureReader::next(RecordedMessage& message)
{
    if (!_damage.empty())
        return false;
    pcap_pkthdr* header = nullptr;
    const std::uint8_t* bytes = nullptr;
    const int status = pcap_next_ex(_capture.get(), &header, &bytes);
    if (status == PCAP_ERROR_BREAK) // the end
        return false;
    if (status != 1)
        return damaged(pcap_geterr(_capture.get()));
    if (header->caplen < header->len)
        return damaged(
            "only " + std::to_string(header->caplen) + " of " + std::to_string(header->len) + " bytes were captured");
    if (header->caplen == 0) // what was not on the disk yet when the power went is zero
        return damaged("a packet without bytes");
    message.time = timeOf(*header);
    message.body = {bytes, header->caplen};
    ++_count;
    _place = _isClassic ? _place + std::int64_t {PacketHeaderSize} + header->caplen : currentPlace();
    return true;
}

bool CaptureReader::damaged(const std::string& why)
{
    _damage = "message " + std::to_string(_count);
    if (_place >= 0)
        _damage += " at byte " + std::to_string(_place);
    _damage += ": " + why;
    return false;
}

/// Classic captures count seconds in 32 bits without sign, which libpcap hands on with one.
Moment CaptureReader::timeOf(const pcap_pkthdr& header) const
{
    const std::int64_t seconds =
        _isClassic ? static_cast<std::uint32_t>(header.ts.tv_sec) : static_cast<std::int64_t>(header.ts.tv_sec);
    constexpr std::int64_t Latest = 1ll << 40; // keeps a hostile pcapng time within what a moment can hold
    return Moment(
        std::chrono::seconds(std::clamp(seconds, -Latest, Latest)) + std::chrono::microseconds(header.ts.tv_usec));
}

} // namespace

bool startsCapture(ByteView firstBytes)
{
    return firstBytes.size() >= 4 && std::ranges::find(Magics, magicOf(firstBytes)) != Magics.end();
}

Result<std::unique_ptr<RecordingReader>> openCapture(RecordingFile file)
{
    const bool isClassic = magicOf(file.peek()) != PcapngMagic;
    char error[PCAP_ERRBUF_SIZE] = "";
    Capture capture(pcap_fopen_offline(file.get(), error));
    if (!capture)
        return Failure {error};
    file.release(); // the capture closes it
    return std::make_unique<CaptureReader>(std::move(capture), isClassic);
}

} // namespace spectrel
