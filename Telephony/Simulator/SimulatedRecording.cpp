#include "Telephony/Simulator/SimulatedRecording.h"

#include <filesystem>
#include <memory>

namespace spectrel {

namespace {

/// "drive.pcap", "drive-2.pcap", ...
std::string numberedPath(const std::string& path, unsigned number)
{
    std::filesystem::path numbered(path);
    if (number > 1)
        numbered.replace_filename(
            numbered.stem().string() + '-' + std::to_string(number) + numbered.extension().string());
    return numbered;
}

/// The files of one recording, one after the other.
class NumberedFiles {
public:
    explicit NumberedFiles(const std::string& path)
        : _path(path)
    {
    }

    void begin(Technology technology)
    {
        if (!finish())
            return;
        if (++_number > 1 && _path == "-")
            return fail({"standard output holds the messages of one technology only"});
        auto created = createRecording(numberedPath(_path, _number), technology);
        if (created)
            _writer = *std::move(created);
        else
            fail(created.failure());
    }
    void write(Moment time, ByteView record)
    {
        if (!_outcome)
            return;
        if (const auto written = _writer->write(time, record); !written)
            fail(written.failure());
    }
    Outcome finish()
    {
        if (_outcome && _writer) {
            if (const auto flushed = _writer->flush(); !flushed)
                fail(flushed.failure());
        }
        return _outcome;
    }
    bool isWriting() const
    {
        return static_cast<bool>(_outcome);
    }

private:
    void fail(const Failure& failure)
    {
        _outcome = failure.of(_path == "-" ? _path : numberedPath(_path, _number));
    }

    std::string _path;
    unsigned _number = 0;
    std::unique_ptr<RecordingWriter> _writer;
    Outcome _outcome = Done();
};

} // namespace

Outcome writeSimulatedRecording(
    Baseband& baseband, const std::string& path, std::chrono::milliseconds duration, const MoveHandler& onMove)
{
    NumberedFiles files(path);
    Moment now = SimulatedRecordingStart;
    const auto write = [&](ByteView record) { files.write(now, record); };
    const auto report = [&] {
        for (const Move& move : baseband.moves()) {
            if (onMove)
                onMove(now, move);
        }
    };
    const auto begin = [&] {
        files.begin(baseband.technology());
        baseband.greet(now, write);
    };
    begin();
    report();
    while (files.isWriting() && now + Baseband::Step <= SimulatedRecordingStart + duration) {
        now += Baseband::Step;
        const Technology before = baseband.technology();
        baseband.advance(now, write);
        report();
        if (baseband.technology() != before)
            begin();
    }
    return files.finish();
}

} // namespace spectrel
