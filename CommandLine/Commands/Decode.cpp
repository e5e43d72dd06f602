#include "CommandLine/Commands/Decode.h"

#include "CommandLine/Commands/EventOutput.h"
#include "CommandLine/Commands/SeparateDecoding.h"
#include "CommandLine/Output/CellOutput.h"
#include "CommandLine/Output/TableOutput.h"
#include "CommandLine/Program/ErrorLine.h"
#include "CommandLine/Program/ProviderNames.h"
#include "LogGenerator/LogGenerator.h"
#include "Monitor/MessageText.h"
#include "Monitor/Viewing/OfflineSession.h"
#include "Records/Beside/Marks.h"

#include <cstdio>
#include <exception>
#include <optional>

namespace spectrel {

namespace {

/// Runs the files through one session and prints as it goes.
class Decoding {
public:
    Decoding(const DecodeOptions& options, const Context& context)
        : _options(options)
        , _session(&LogGenerator::generatorFromTechnology, options.snapshotDirectory.has_value(), context)
        , _journal(printsChanges(options.output.format) ? &_session.displayState().followChanges() : nullptr)
        , _output(stdout, options.output)
    {
        if (options.output.format == OutputFormat::Events || options.events.hasAlarms())
            _events.emplace(_session.displayState(), options.events, options.output, _output, &_operators);
        if (options.output.format == OutputFormat::Table) {
            _table.emplace(_session.displayState(), _output, options.output, &_operators);
            _session.setTickHandler([this](Moment tick) { _table->refresh(tick); });
        }
        if (printsCells(options.output.format)) {
            _cells.emplace(_session.displayState(), _output, options.output, &_operators);
            _session.setTickHandler([this](Moment tick) { _cells->refresh(tick); });
        }
    }

    int run()
    {
        for (const std::string& file : _options.files) {
            if (!decodeFile(file))
                break;
        }
        if (_events)
            _events->finish();
        if (!_options.each)
            _output.printDisplay(_session.display());
        if (_session.messages() > 0)
            printLast();
        saveSnapshot();
        if (_options.events.until && !_events->isUntilMet())
            fail("the alarm '" + _options.events.until->text + "' was not raised");
        if (!_output.flush())
            fail("standard output: cannot be written");
        return _status;
    }

private:
    /// What ticks print, once more after the last message.
    void printLast()
    {
        if (_table)
            _table->refresh(_session.lastTime());
        if (_cells)
            _cells->refresh(_session.lastTime());
    }

    void fail(const std::string& line)
    {
        _output.flush(); // what was decoded comes before the complaint
        report(line);
        _status = 1;
    }

    /// False when a message or an alarm has ended the decoding.
    bool decodeFile(const std::string& path)
    {
        const bool isStandardInput = path == "-";
        const std::string file = isStandardInput ? "standard input" : path;
        const auto opened = openRecording(isStandardInput ? "/dev/stdin" : path);
        if (!opened) {
            fail(opened.failure().of(file).text);
            return true;
        }
        const auto& reader = *opened;
        const auto technology = reader->technology() ? reader->technology() : _options.technology;
        if (!technology) {
            fail(file + ": does not tell its technology; name it with --technology");
            return true;
        }
        _session.useTechnology(*technology);
        if (_options.output.format == OutputFormat::Events && !isStandardInput)
            addBookmarks(path);
        RecordedMessage message;
        while (reader->next(message)) {
            if (!decodeMessage(file, message))
                return false;
        }
        if (!reader->damage().empty())
            fail(file + ": " + reader->damage());
        return true;
    }

    void addBookmarks(const std::string& recording)
    {
        const Marks marks = readMarks(recording);
        for (const Mark& mark : marks.marks)
            _events->addBookmark(mark.time, mark.note);
        if (!marks.damage.empty())
            fail(marks.damage);
    }

    bool decodeMessage(const std::string& file, const RecordedMessage& message)
    {
        const std::uint64_t n = _n++;
        try {
            _session.apply(message);
        } catch (const std::exception& raised) {
            const std::string line = file + ": message " + std::to_string(n) + " (" + codeText(message.body)
                + ") ends the program: " + exceptionName(raised);
            if (!_options.keepGoing) {
                fail(line);
                return false;
            }
            _output.flush();
            report(line);
        }
        if (_options.each)
            _output.printNumberedJson(n, _session.display());
        else if (_journal)
            _output.printChanges(n, message.time, _session.display(), *_journal);
        return !_events || !_events->isUntilMet();
    }

    void saveSnapshot()
    {
        if (!_options.snapshotDirectory)
            return;
        if (const Outcome saved = _session.saveSnapshot(*_options.snapshotDirectory); !saved)
            fail("cannot write the snapshot: " + saved.failure().text);
    }

    const DecodeOptions& _options;
    OfflineSession _session;
    Journal* const _journal; // where changes are printed
    OutputWriter _output;
    ProviderNames _operators;
    std::optional<CellOutput> _cells;
    std::optional<TableOutput> _table;
    std::optional<EventOutput> _events; // where events are printed
    std::uint64_t _n = 0;
    int _status = 0;
};

} // namespace

int decode(const DecodeOptions& options, const Context& context)
{
    if (options.separate)
        return decodeSeparately(options, context);
    return Decoding(options, context).run();
}

} // namespace spectrel
