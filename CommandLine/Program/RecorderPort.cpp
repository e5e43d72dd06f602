#include "CommandLine/Program/RecorderPort.h"

#include "Values/Dictionary.h"
#include "Values/PropertyList/PropertyList.h"

#include <chrono>
#include <cstdint>
#include <optional>
#include <utility>

namespace spectrel {

namespace {

using namespace std::chrono_literals;

constexpr std::int32_t RequestId = 0;
constexpr const char* GetRecording = "GetRecording"; // a request's key; its value is the same text
constexpr const char* AddMark = "Mark"; // a request's key; its value is the note
constexpr const char* Recording = "Recording"; // a reply's keys
constexpr const char* Error = "Error";

Bytes bytesOf(const Value& list)
{
    const auto text = serialisePropertyList(list);
    return text ? Bytes(text->begin(), text->end()) : Bytes();
}

Bytes reply(const Result<std::string>& recording)
{
    if (recording)
        return bytesOf(Dictionary::make({{Recording, *recording}}));
    return bytesOf(Dictionary::make({{Error, recording.failure().text}}));
}

Bytes answer(ByteView request, const RecorderPort::Handlers& handlers)
{
    const auto list = parsePropertyList(request);
    if (list && list->dictionary()) {
        const Dictionary& asked = *list->dictionary();
        if (const std::string* const note = asked[AddMark].string())
            return reply(handlers.mark(*note));
        if (asked[GetRecording].string())
            return reply(handlers.recording());
    }
    return reply(Failure {"not a request of bookmarks"});
}

Result<std::string> ask(RemoteMessagePort& recorder, const char* key, const std::string& value)
{
    const Bytes request = bytesOf(Dictionary::make({{key, value}}));
    std::optional<Bytes> body;
    if (request.empty())
        return Failure {"the text holds control characters that it cannot be sent with"};
    if (recorder.sendRequest(RequestId, request, 1s, 3s, ReplyMode::Wait, &body) != SendStatus::Success || !body)
        return Failure {"the recorder at " + recorder.name() + " does not answer"};
    const auto list = parsePropertyList(*body);
    if (list && list->dictionary()) {
        const Dictionary& given = *list->dictionary();
        if (const std::string* const recording = given[Recording].string())
            return *recording;
        if (const std::string* const error = given[Error].string())
            return Failure {*error};
    }
    return Failure {"the recorder at " + recorder.name() + " gives no answer that is understood"};
}

} // namespace

RecorderPort::RecorderPort(MessagePorts& ports, const std::string& portPrefix, Handlers handlers)
    : _port(ports
                .createLocal(portPrefix + std::string(NameEnding),
                    [handlers = std::move(handlers)](
                        std::int32_t, ByteView body) { return std::optional(answer(body, handlers)); })
                .port)
{
    if (_port)
        _port->serve();
}

RecorderPort::~RecorderPort()
{
    if (_port)
        _port->invalidate();
}

Result<std::string> markRunningRecording(
    MessagePorts& ports, const std::vector<std::string>& names, const std::string& note)
{
    std::vector<std::shared_ptr<RemoteMessagePort>> recorders;
    for (const std::string& name : names) {
        if (auto recorder = ports.createRemote(name))
            recorders.push_back(std::move(recorder));
    }
    if (recorders.empty())
        return Failure {"no recorder is running; name a recording with --recording"};
    if (recorders.size() == 1)
        return ask(*recorders.front(), AddMark, note);
    std::string files;
    for (const auto& recorder : recorders) {
        const auto recording = ask(*recorder, GetRecording, GetRecording);
        files += (files.empty() ? "" : ", ") + (recording ? *recording : recorder->name());
    }
    return Failure {"several recorders are running (" + files + "); name a recording with --recording"};
}

} // namespace spectrel
