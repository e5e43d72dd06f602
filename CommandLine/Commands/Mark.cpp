#include "CommandLine/Commands/Mark.h"

#include "CommandLine/Program/ErrorLine.h"
#include "CommandLine/Program/ExitStatus.h"
#include "CommandLine/Program/RecorderPort.h"
#include "Platform/Places.h"
#include "Platform/Qt/QtClock.h"
#include "Platform/Qt/QtRunLoop.h"
#include "Platform/Sockets/ServedPorts.h"
#include "Platform/Sockets/SocketMessagePorts.h"
#include "Records/Beside/Marks.h"

#include <filesystem>
#include <system_error>

namespace spectrel {

namespace {

Result<std::string> markNamedRecording(const std::string& recording, const std::string& note)
{
    std::error_code error;
    if (!std::filesystem::is_regular_file(recording, error))
        return Failure {error ? error.message() : "is no recording"}.of(recording);
    if (auto appended = appendMark(recording, {QtClock().now(), note}); !appended)
        return appended.failure();
    return recording;
}

Result<std::string> markRunning(const std::string& note)
{
    QtRunLoop runLoop; // which the ports need
    SocketMessagePorts ports(Places::portDirectory());
    const auto names = servedPorts(Places::portDirectory(), RecorderPort::NamePrefix, RecorderPort::NameEnding);
    return markRunningRecording(ports, names, note);
}

} // namespace

int mark(const MarkOptions& options)
{
    const auto marked =
        options.recording ? markNamedRecording(*options.recording, options.note) : markRunning(options.note);
    report(marked ? marksPath(*marked) + ": one more bookmark" : marked.failure().text);
    return marked ? ExitStatus::Done : ExitStatus::Failed;
}

} // namespace spectrel
