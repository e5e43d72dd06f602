#include "CommandLine/Record.h"

#include "CommandLine/LiveServices.h"
#include "CommandLine/Report.h"
#include "Platform/Qt/TerminationSignals.h"
#include "Platform/Recording.h"

#include <cerrno>
#include <cstring>
#include <filesystem>
#include <unistd.h>

namespace spectrel {

namespace {

/// Messages reach the file at the latest this long after they came.
constexpr std::chrono::milliseconds FlushDelay {500};

class Recorder final : public SpectrelModelObserver {
public:
    explicit Recorder(const RecordOptions& options)
        : _options(options)
        , _model(_live.services(), *this, LiveServices::portPrefixFor("Record"))
    {
    }

    int run()
    {
        if (const std::filesystem::path folder = std::filesystem::path(_options.file).parent_path();
            _options.file != "-" && ::access(folder.empty() ? "." : folder.c_str(), W_OK) != 0) {
            fail(_options.file + ": " + std::strerror(errno));
            return _status;
        }
        const TerminationSignals terminationSignals([this](int) { _live.runLoop().quit(); });
        _live.runLoop().async([this] { _model.restartMonitor(); });
        if (_options.duration)
            _live.runLoop().after(*_options.duration, [this] { _live.runLoop().quit(); });
        _live.runLoop().run();
        _model.destroyPorts();
        flush();
        if (!_writer && _status == 0)
            fail(_options.file + ": nothing was recorded, for no session was opened");
        else if (_status == 0)
            report(_path + ": " + std::to_string(_messages) + " messages");
        return _status;
    }

    bool modelShouldApply(ByteView body) override
    {
        if (_status == 0 && openWriter())
            write(body);
        return false;
    }
    void updateViewControllerFromModel() override { }
    void sessionDidChange() override
    {
        if (_model.isConnected())
            openWriter();
        else if (!_model.lostReason().empty())
            report("Connecting... (" + _model.lostReason() + ")");
    }

private:
    void fail(const std::string& line)
    {
        report(line);
        _status = 1;
        _live.runLoop().quit();
    }

    /// The capture's link type tells the technology, so another technology needs another file.
    bool openWriter()
    {
        const auto technology = technologyOfConstant(_model.technology());
        if (!technology)
            return false;
        if (_writer && technology == _technology)
            return true;
        flush();
        if (_writer)
            ++_files;
        _path = pathOfFile();
        std::string reason;
        _writer = createRecording(_path, *technology, reason);
        _technology = *technology;
        if (!_writer) {
            fail(_path + ": " + reason);
            return false;
        }
        if (_files > 1)
            report("the technology is now " + std::string(technologyName(*technology)) + "; recording into " + _path);
        return true;
    }

    /// FILE, then FILE-2, FILE-3, ... with the extension kept.
    std::string pathOfFile() const
    {
        const std::filesystem::path path(_options.file);
        if (_files == 1)
            return _options.file;
        return (path.parent_path() / (path.stem().string() + "-" + std::to_string(_files) + path.extension().string()))
            .string();
    }

    void write(ByteView body)
    {
        if (!_writer->write(Clock::installed().now(), body))
            return fail(_path + ": " + _writer->error());
        if (!_flushIsDue) {
            _flushIsDue = true;
            _live.runLoop().after(FlushDelay, [this] { flush(); });
        }
        if (++_messages == _options.count)
            _live.runLoop().quit();
    }

    void flush()
    {
        _flushIsDue = false;
        if (_writer && !_writer->flush() && _status == 0)
            fail(_path + ": " + _writer->error());
    }

    const RecordOptions& _options;
    LiveServices _live;
    SpectrelModel _model;
    std::unique_ptr<RecordingWriter> _writer;
    std::string _path;
    Technology _technology = Technology::LTE;
    int _files = 1;
    std::uint64_t _messages = 0;
    bool _flushIsDue = false;
    int _status = 0;
};

} // namespace

int record(const RecordOptions& options)
{
    return Recorder(options).run();
}

} // namespace spectrel
