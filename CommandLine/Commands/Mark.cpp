#include "CommandLine/Commands/Mark.h"

#include "CommandLine/Program/ErrorLine.h"
#include "CommandLine/Program/ExitStatus.h"
#include "CommandLine/Program/RecorderPort.h"
#include "Platform/Places.h"
#include "Platform/Qt/QtRunLoop.h"
#include "Platform/Sockets/ServedPorts.h"
#include "Platform/Sockets/SocketMessagePorts.h"
#include "Records/Beside/Marks.h"

#include <filesystem>
#include <system_error>

namespace spectrel {

namespace {

Result<std::string> markNamedRecording(const std::string& recording, const Mark& mark)
{
    std::error_code error;
    if (!std::filesystem::is_regular_file(recording, error))
        return Failure {error ? error.message() : "is no recording"}.of(recording);
    if (auto appended = appendMark(recording, mark); !appended)
        return appended.failure();
    return recording;
}

Result<std::string> markRunning(const std::string& note, const Context& context)
{
    QtRunLoop runLoop; // which the ports need
    SocketMessagePorts ports(Places::portDirectory(), context.log);
    const auto names = servedPorts(Places::portDirectory(), RecorderPort::NamePrefix, RecorderPort::NameEnding);
    return markRunningRecording(ports, names, note);
}

} // namespace

int mark(const MarkOptions& options, const Context& context)
{
    const auto marked = options.recording ? markNamedRecording(*options.recording, {context.clock.now(), options.note})
                                          : markRunning(options.note, context);
    report(marked ? marksPath(*marked) + ": one more bookmark" : marked.failure().text);
    return marked ? ExitStatus::Done : ExitStatus::Failed;
}

} // namespace spectrel
