#include "CommandLine/Commands/SeparateDecoding.h"

#include "CommandLine/Program/ErrorLine.h"
#include "CommandLine/Program/ExitStatus.h"

#include <algorithm>
#include <array>
#include <cerrno>
#include <csignal>
#include <cstdio>
#include <memory>
#include <optional>
#include <string>
#include <sys/prctl.h>
#include <sys/wait.h>
#include <thread>
#include <unistd.h>
#include <vector>

namespace spectrel {

namespace {

/// Files whose output may wait for its turn, for each that is being decoded.
constexpr std::size_t WaitingPerJob = 4;

struct CloseFile {
    void operator()(std::FILE* file) const
    {
        std::fclose(file);
    }
};
using TemporaryFile = std::unique_ptr<std::FILE, CloseFile>; // without a name: goes with its process

/// Passes on what was written to the file. False when it cannot be.
bool copyTo(std::FILE* stream, std::FILE* file)
{
    std::array<char, 64 * 1024> bytes;
    std::rewind(file);
    while (const std::size_t count = std::fread(bytes.data(), 1, bytes.size(), file)) {
        if (std::fwrite(bytes.data(), 1, count, stream) != count)
            return false;
    }
    return !std::ferror(file) && std::fflush(stream) == 0;
}

class SeparateDecoding {
public:
    SeparateDecoding(const DecodeOptions& options, const Context& context)
        : _options(options)
        , _context(context)
        , _jobs(options.jobs.value_or(std::max(1U, std::thread::hardware_concurrency())))
    {
    }

    int run()
    {
        std::signal(SIGCHLD, SIG_DFL); // where it was ignored, nobody would hear how the processes ended
        while (_printed < _options.files.size() && !_hasFailedToPrint) {
            if (_started < _options.files.size() && _running < _jobs && _started - _printed < WaitingPerJob * _jobs) {
                if (start() == Side::File)
                    return decodeFile();
            } else if (_sessions[_printed].status) {
                print(_sessions[_printed++]);
            } else {
                awaitOne();
            }
        }
        while (_running > 0)
            awaitOne();
        return _status;
    }

private:
    /// Which of the two processes is back from a fork.
    enum class Side { Program, File };

    struct Session {
        pid_t process = 0;
        TemporaryFile output;
        TemporaryFile complaints;
        std::optional<int> status; // as the system tells it, when the process has ended
    };

    const std::string& file() const
    {
        return _options.files[_started];
    }

    Side start()
    {
        Session session {0, TemporaryFile(std::tmpfile()), TemporaryFile(std::tmpfile()), std::nullopt};
        std::fflush(nullptr); // what is gathered belongs to this process alone
        session.process = session.output && session.complaints ? ::fork() : -1;
        if (session.process == 0) {
            ::prctl(PR_SET_PDEATHSIG, SIGTERM);
            ::dup2(::fileno(session.output.get()), STDOUT_FILENO);
            ::dup2(::fileno(session.complaints.get()), STDERR_FILENO);
            return Side::File;
        }
        if (session.process < 0) {
            if (session.complaints)
                std::fprintf(session.complaints.get(), "spectrel: %s: cannot be decoded apart\n", file().c_str());
            session.status = ExitStatus::Failed << 8;
        } else {
            ++_running;
        }
        _sessions.push_back(std::move(session));
        ++_started;
        return Side::Program;
    }

    int decodeFile() const
    {
        DecodeOptions alone = _options;
        alone.separate = false;
        alone.files = {file()};
        alone.output.file = file() == "-" ? "standard input" : file();
        alone.output.hasHeader = _started == 0;
        return decode(alone, _context);
    }

    void awaitOne()
    {
        int status = 0;
        const pid_t process = ::waitpid(-1, &status, 0);
        const auto ended = std::ranges::find_if(
            _sessions, [process](const Session& session) { return session.process == process && !session.status; });
        if (process < 0 || ended == _sessions.end())
            return;
        ended->status = status;
        --_running;
    }

    void print(Session& session)
    {
        if (session.output && !copyTo(stdout, session.output.get())) {
            report("standard output: cannot be written");
            _hasFailedToPrint = true;
        }
        if (session.complaints)
            copyTo(stderr, session.complaints.get());
        if (WIFSIGNALED(*session.status))
            report(_options.files[_printed - 1] + ": its process was ended by signal "
                + std::to_string(WTERMSIG(*session.status)));
        if (*session.status != 0 || _hasFailedToPrint)
            _status = ExitStatus::Failed;
        session.output.reset();
        session.complaints.reset();
    }

    const DecodeOptions& _options;
    const Context& _context;
    const std::size_t _jobs;
    std::vector<Session> _sessions; // in the order of the files
    std::size_t _started = 0;
    std::size_t _running = 0;
    std::size_t _printed = 0;
    bool _hasFailedToPrint = false;
    int _status = ExitStatus::Done;
};

} // namespace

int decodeSeparately(const DecodeOptions& options, const Context& context)
{
    return SeparateDecoding(options, context).run();
}

} // namespace spectrel
