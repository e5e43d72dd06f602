#include "CommandLine/Commands/Report.h"

#include "Analysis/Report/ReportCollector.h"
#include "Analysis/Report/ReportPage.h"
#include "CommandLine/Commands/RecordingInputs.h"
#include "CommandLine/Output/ReportFile.h"
#include "CommandLine/Program/ErrorLine.h"
#include "CommandLine/Program/ExitStatus.h"
#include "CommandLine/Program/ProviderNames.h"
#include "LogGenerator/LogGenerator.h"
#include "Monitor/MessageText.h"
#include "Monitor/Viewing/OfflineSession.h"
#include "Records/Beside/Gaps.h"
#include "Records/Beside/Marks.h"

#include <algorithm>
#include <array>
#include <cstddef>
#include <cstdint>
#include <exception>
#include <filesystem>
#include <utility>

namespace spectrel {

namespace {

constexpr std::size_t MaxRemarks = 10; // of a recording

/// Plays one recording, which may be several files, and gathers what the report shows of it.
class RecordingAnalysis {
public:
    RecordingAnalysis(
        const ReportOptions& options, ReportedRecording& recording, OperatorNames& operators, const Context& context)
        : _options(options)
        , _recording(recording)
        , _session(&LogGenerator::generatorFromTechnology, false, context)
        , _collector(_session.displayState(), recording, options.thresholds, &operators)
    {
    }

    void play(RecordingInput& input)
    {
        _recording.files.push_back(std::filesystem::path(input.name).filename());
        const auto technology = input.reader->technology() ? input.reader->technology() : _options.technology;
        if (!technology) {
            complain(input.name + ": does not name its technology; name it with --technology");
            return;
        }
        noteTechnology(*technology);
        _session.useTechnology(*technology);
        readBeside(input.path);
        if (!input.isEmpty)
            playMessages(input);
        if (!input.reader->damage().empty())
            complain(input.name + ": " + input.reader->damage());
    }

    /// False when something was wrong with a file.
    bool finish()
    {
        _collector.finish();
        return _isWhole;
    }

private:
    void noteTechnology(Technology technology)
    {
        const std::string name(technologyName(technology));
        auto& names = _recording.technologies;
        if (std::find(names.begin(), names.end(), name) == names.end())
            names.push_back(name);
    }

    /// The bookmarks of a recording and its gaps.
    void readBeside(const std::string& path)
    {
        if (path == "-")
            return;
        const Marks marks = readMarks(path);
        for (const Mark& mark : marks.marks)
            _collector.addBookmark(mark.time, mark.note);
        const Gaps gaps = readGaps(path);
        for (const Gap& gap : gaps.gaps)
            _recording.lostMessages += gap.lost;
        for (const std::string& damage : {marks.damage, gaps.damage}) {
            if (!damage.empty())
                complain(damage);
        }
    }

    void playMessages(RecordingInput& input)
    {
        RecordedMessage message = input.first;
        std::uint64_t n = 0;
        do {
            try {
                _session.apply(message);
            } catch (const std::exception& raised) {
                complain(input.name + ": message " + std::to_string(n) + " (" + codeText(message.body)
                    + ") ends the program: " + exceptionName(raised));
            }
            ++n;
        } while (input.reader->next(message));
    }

    /// On standard error and, up to a limit, in the report.
    void complain(const std::string& line)
    {
        report(line);
        _isWhole = false;
        if (_recording.remarks.size() < MaxRemarks)
            _recording.remarks.push_back(line);
    }

    const ReportOptions& _options;
    ReportedRecording& _recording;
    OfflineSession _session;
    ReportCollector _collector;
    bool _isWhole = true;
};

bool isDigit(char character)
{
    return character >= '0' && character <= '9';
}

/// Files of one recording next to each other, by the recordings' first messages.
std::vector<std::vector<RecordingInput>> recordingsOf(std::vector<RecordingInput> inputs)
{
    std::vector<std::vector<RecordingInput>> recordings;
    for (RecordingInput& input : inputs) {
        const std::string name = recordingOfFile(input.path);
        const auto known = std::find_if(recordings.begin(), recordings.end(),
            [&name](const std::vector<RecordingInput>& files) { return recordingOfFile(files.front().path) == name; });
        auto& files = known == recordings.end() ? recordings.emplace_back() : *known;
        files.push_back(std::move(input));
    }
    return recordings;
}

std::string titleOf(const std::vector<RecordingInput>& files)
{
    return files.front().path == "-" ? files.front().name
                                     : std::filesystem::path(recordingOfFile(files.front().path)).filename().string();
}

} // namespace

std::string recordingOfFile(std::string_view path)
{
    const std::filesystem::path file(path);
    std::string stem = file.stem();
    for (const auto technology :
        {Technology::IFX, Technology::GSM, Technology::CDMA, Technology::LTE, Technology::UTRAN}) {
        const std::string ending = "-" + std::string(technologyName(technology));
        if (stem.size() > ending.size() && stem.ends_with(ending)) {
            stem.resize(stem.size() - ending.size());
            break;
        }
    }
    const auto end = std::find_if_not(stem.rbegin(), stem.rend(), isDigit).base();
    const bool isNumbered = end != stem.end() && end - stem.begin() > 1 && *std::prev(end) == '-';
    if (isNumbered)
        stem.erase(std::prev(end), stem.end());
    else
        stem = file.stem();
    return (file.parent_path() / stem).string();
}

int writeReport(const ReportOptions& options, const Context& context)
{
    RecordingInputs opened = openRecordings(options.files);
    for (const std::string& failure : opened.failures)
        report(failure);
    bool isWhole = opened.failures.empty();
    ProviderNames operators;
    std::vector<ReportedRecording> recordings;
    for (std::vector<RecordingInput>& files : recordingsOf(std::move(opened.inputs))) {
        ReportedRecording& recording = recordings.emplace_back();
        recording.title = titleOf(files);
        RecordingAnalysis analysis(options, recording, operators, context);
        for (RecordingInput& file : files)
            analysis.play(file);
        isWhole = analysis.finish() && isWhole;
    }
    if (recordings.empty())
        return ExitStatus::Failed;
    if (const Outcome written = writeReportFile(options.output, reportPage(recordings)); !written) {
        report(written.failure().text);
        return ExitStatus::Failed;
    }
    return isWhole ? ExitStatus::Done : ExitStatus::Failed;
}

} // namespace spectrel
