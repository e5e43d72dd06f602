#include "CommandLine/Program/CrashReport.h"

#include "CommandLine/Program/ErrorLine.h"
#include "Monitor/DisplayState.h"
#include "Monitor/MessageText.h"
#include "Monitor/Snapshot.h"
#include "Platform/Context.h"
#include "Platform/Places.h"

#include <chrono>
#include <cstdlib>
#include <exception>
#include <filesystem>
#include <system_error>
#include <utility>

namespace spectrel {

namespace {

DisplayState* endingDisplay = nullptr;
const Clock* endingClock = nullptr; // both are there once something was installed
SystemLog* endingLog = nullptr;
std::function<void()> giveScreenBack;
std::string reasonOfEnding = "unknown reason";

std::string currentExceptionName()
{
    try {
        if (const auto current = std::current_exception())
            std::rethrow_exception(current);
    } catch (const std::exception& exception) {
        return exceptionName(exception);
    } catch (...) {
        return "an exception of unknown kind";
    }
    return "no exception: the program was told to terminate";
}

/// No snapshot that the user has just saved is overwritten: the seconds in the name go on until one is free.
std::string freeSnapshotPath(Moment now)
{
    std::string path;
    std::error_code error;
    do {
        path = snapshotPath(Places::crashLogDirectory(), now);
        now += std::chrono::seconds(1);
    } while (std::filesystem::exists(path, error));
    return path;
}

void tellEverywhere(const std::string& line)
{
    report(line);
    SPECTREL_LOG(*endingLog, Priority::Error, "%s", line.c_str());
}

} // namespace

void Ending::install(DisplayState& display, const Context& context, std::function<void()> restoreScreen)
{
    endingDisplay = &display;
    endingClock = &context.clock;
    endingLog = &context.log;
    giveScreenBack = std::move(restoreScreen);
    std::set_terminate(&Ending::terminate);
}

void Ending::remove()
{
    endingDisplay = nullptr;
    giveScreenBack = {};
}

void Ending::terminate() noexcept
{
    static bool isEnding = false;
    if (!std::exchange(isEnding, true)) {
        if (giveScreenBack)
            giveScreenBack();
        tell();
        saveWhatIsLeft();
    }
    std::abort();
}

void Ending::tell()
{
    reasonOfEnding = "ended by " + currentExceptionName();
    const ByteView message = endingDisplay ? endingDisplay->messageInProgress() : ByteView();
    if (message.empty())
        return tellEverywhere(reasonOfEnding);
    tellEverywhere(reasonOfEnding + ", raised by a message of " + std::to_string(message.size()) + " bytes, "
        + codeText(message) + ": " + hexadecimal(message));
}

void Ending::saveWhatIsLeft()
{
    if (!endingDisplay)
        return;
    const ListRef contents = std::exchange(endingDisplay, nullptr)->lastContents();
    if (!contents)
        return;
    const Moment now = endingClock->now();
    const std::string path = freeSnapshotPath(now);
    std::string reason;
    if (writeSnapshot(makeSnapshot(now, contents, "Spectrel " + reasonOfEnding), path, reason))
        tellEverywhere("what was received is kept in " + path);
    else
        tellEverywhere("cannot write " + path + ": " + reason);
}

} // namespace spectrel
