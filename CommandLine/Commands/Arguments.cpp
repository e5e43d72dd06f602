#include "CommandLine/Commands/Arguments.h"

#include "CommandLine/Options/OptionTypes.h"
#include "CommandLine/Program/ErrorLine.h"
#include "Records/Beside/Marks.h"

#include <CLI/CLI.hpp>
#include <iostream>
#include <limits>
#include <utility>
#include <vector>

namespace spectrel {

namespace {

constexpr const char* Description =
    "Live radio diagnostics: which cell am I on, how well do I hear it, what else is there?\n"
    "Without a command it opens the screens; where there is no terminal and no display it prints as 'watch' does.";

constexpr const char* Environment =
    "Environment:\n"
    "  SPECTREL_PORT_DIR       where the telephony service is met (default: $XDG_RUNTIME_DIR/spectrel)\n"
    "  SPECTREL_CRASH_LOG_DIR  where snapshots go (default: $XDG_STATE_HOME/spectrel/CrashReporter)\n"
    "  SPECTREL_DEVICE_ROOT    prefix of the device's absolute paths (default: /)\n"
    "  SPECTREL_DIAGNOSTIC_LOG file for what the decoders tell their developers (default: none)\n"
    "  NO_COLOR                no colours in the terminal screens\n"
    "Exit status: 0 done, 1 something could not be done, 2 wrong usage.";

constexpr OptionForm<OutputFormat> FormatForm {"tree|json|changes|csv|table|cells|summary|events|none",
    outputFormatNamed, "is not one of tree, json, changes, csv, table, cells, summary, events, none"};

constexpr OptionForm<std::string> CommandForm {"COMMAND",
    [](std::string_view text) { return text.empty() ? std::nullopt : std::optional<std::string>(text); },
    "is no command"};

std::optional<std::string> parseNote(std::string_view text)
{
    const bool isNote = !text.empty() && text.size() <= LongestNote;
    return isNote ? std::optional<std::string>(text) : std::nullopt;
}

constexpr OptionForm<std::string> NoteForm {"TEXT", parseNote, "is no note of 1 to 4096 bytes"};
static_assert(LongestNote == 4096);

constexpr OptionForm<std::vector<TableColumn>> ColumnsForm {
    "PATH[=NAME],...|cells", parseTableColumns, "is no list of columns PATH[=NAME],..."};

constexpr OptionForm<TimeForm> TimeFormForm {"seconds|rfc3339", timeFormNamed, "is not one of seconds, rfc3339"};

void addOutput(CLI::App& command, OutputOptions& output)
{
    addFormedOption(command, "--format", output.format, FormatForm, "How the display is printed (default: tree)");
    command
        .add_option("--path", output.paths,
            "Print only the leaves with such a path: * stands for any text within a name, ** across names (repeatable)")
        ->type_name("GLOB")
        ->expected(1)
        ->take_all()
        ->check([](const std::string& glob) { return glob.empty() ? "'' is no path" : ""; });
    addFormedOption(command, "--columns", output.columns, ColumnsForm,
        "With --format table: the leaves that make its columns, and what stands above them; cells: the serving cell");
    addFormedOption(command, "--time", output.time, TimeFormForm,
        "How times are printed: seconds since 1970 (default), or as 2024-03-05T14:07:31.123456Z");
    command.add_flag("--sources", output.withSources, "With --format cells: where in the tree each value comes from");
}

/// What no single option can say.
void checkOutput(const OutputOptions& output)
{
    const bool isTable = output.format == OutputFormat::Table;
    if (isTable && output.columns.empty())
        throw CLI::ValidationError("--format", "table needs --columns");
    if (!isTable && !output.columns.empty())
        throw CLI::ValidationError("--columns", "goes with --format table only");
    if (isTable && !output.paths.empty())
        throw CLI::ValidationError("--path", "a table has its --columns");
    if (printsCells(output.format) && !output.paths.empty())
        throw CLI::ValidationError("--path", "chooses leaves, of which cells and summary print none");
    if (output.withSources && output.format != OutputFormat::Cells)
        throw CLI::ValidationError("--sources", "goes with --format cells only");
}

/// Several may be given. The reader throws what makes the option wrong usage.
template <typename Take>
CLI::Option* addRepeatedOption(CLI::App& command, const std::string& name, Take take, const std::string& description)
{
    const auto takeAll = [take, name](const std::vector<std::string>& texts) {
        for (const std::string& text : texts) {
            if (const Outcome taken = take(text); !taken)
                throw CLI::ValidationError(name, taken.failure().text);
        }
    };
    return command.add_option_function<std::vector<std::string>>(name, takeAll, description)
        ->expected(1, 1)
        ->multi_option_policy(CLI::MultiOptionPolicy::TakeAll);
}

void addEvents(CLI::App& command, EventOptions& events)
{
    const auto takeAlarm = [](const std::string& text, auto store) -> Outcome {
        auto alarm = parseAlarm(text);
        if (!alarm)
            return alarm.failure();
        store(*std::move(alarm));
        return Done();
    };
    addRepeatedOption(
        command, "--alarm",
        [&events, takeAlarm](const std::string& text) {
            return takeAlarm(text, [&events](AlarmCondition alarm) { events.alarms.push_back(std::move(alarm)); });
        },
        "Raise an alarm, such as 'RSRP < -110 for 10s': a level of the serving cell or a path in quotes, a comparison, "
        "a number and a time; may be given several times")
        ->type_name("ALARM");
    addFormedOption(command, "--alarm-command", events.alarmCommand, CommandForm,
        "Run this command of the shell at each alarm, with the event on its standard input");
    addRepeatedOption(
        command, "--until",
        [&events, takeAlarm](const std::string& text) {
            return takeAlarm(text, [&events](AlarmCondition alarm) { events.until = std::move(alarm); });
        },
        "End when this alarm is raised")
        ->type_name("ALARM");
    addRepeatedOption(
        command, "--threshold", [&events](const std::string& text) { return events.thresholds.set(text); },
        "With --format events: set what a finding depends on; may be given several times")
        ->type_name("NAME=VALUE");
}

void addLimits(CLI::App& command, std::optional<std::uint64_t>& count, const char* what,
    std::optional<std::chrono::milliseconds>& duration)
{
    addFormedOption(command, "--count", count, CountForm, what);
    addFormedOption(command, "--duration", duration, DurationForm, "End after this time");
}

void addVersion(CLI::App& command)
{
    command.set_version_flag("--version", "spectrel " SPECTREL_VERSION);
}

void addCommon(CLI::App& command, Arguments& arguments)
{
    addVersion(command);
    addFormedOption(
        command, "--resources", arguments.resources, FolderForm, "Take the display templates from this folder");
    addFormedOption(
        command, "--log", arguments.logFile, FileForm, "Write every system-log line to this file: <PRIORITY>TEXT");
}

std::optional<std::uint32_t> parseChannel(std::string_view text)
{
    const auto number = parseWholeNumber(text, 0, std::numeric_limits<std::uint32_t>::max());
    return number ? std::optional(static_cast<std::uint32_t>(*number)) : std::nullopt;
}

std::optional<double> parseFrequency(std::string_view text)
{
    return parseNumber(text, 0, 1e6);
}

constexpr OptionForm<ChannelTechnology> ChannelTechnologyForm {
    "lte|utran|gsm|cdma", channelTechnologyNamed, "is not one of lte, utran, gsm, cdma"};
constexpr OptionForm<ChannelFormat> ChannelFormatForm {"text|json", channelFormatNamed, "is not one of text, json"};
constexpr OptionForm<std::uint32_t> ChannelForm {"NUMBER", parseChannel, "is no channel number"};
constexpr OptionForm<double> FrequencyForm {"FREQUENCY", parseFrequency, "is no frequency in MHz"};

void addScreens(CLI::App& command, Arguments& arguments)
{
    auto* graphical = command.add_flag_callback(
        "--gui", [&arguments] { arguments.screens = ScreenChoice::Graphical; }, "Open the graphical screens");
    command
        .add_flag_callback(
            "--terminal", [&arguments] { arguments.screens = ScreenChoice::Terminal; }, "Open the terminal screens")
        ->excludes(graphical);
}

void addTechnology(CLI::App& command, std::optional<Technology>& technology)
{
    addFormedOption(
        command, "--technology", technology, TechnologyForm, "The technology, where the file does not tell");
}

void addWatch(CLI::App& program, Arguments& arguments)
{
    CLI::App& command = *program.add_subcommand("watch", "Print the live session, once at each refresh");
    command.callback([&arguments] { arguments.job = Job::Watch; });
    addCommon(command, arguments);
    addOutput(command, arguments.watch.output);
    addEvents(command, arguments.watch.events);
    addLimits(command, arguments.watch.count, "End after this many refreshes", arguments.watch.duration);
}

void addDecode(CLI::App& program, Arguments& arguments)
{
    DecodeOptions& decode = arguments.decode;
    CLI::App& command = *program.add_subcommand(
        "decode", "Decode recordings (captures, snapshots, DLF files) offline and print the display");
    command.callback([&arguments] { arguments.job = Job::Decode; });
    addCommon(command, arguments);
    command.add_option("FILE", decode.files, "The recordings, decoded one after the other; - is standard input")
        ->required()
        ->type_name("");
    addOutput(command, decode.output);
    addEvents(command, decode.events);
    command.add_flag("--each", decode.each, "With --format json: one line for each message");
    addTechnology(command, decode.technology);
    addFormedOption(command, "--snapshot", decode.snapshotDirectory, FolderForm,
        "Write a snapshot file into this folder at the end");
    command.add_flag("--keep-going", decode.keepGoing, "Go on after a message that would end the program");
    command.add_flag("--separate", decode.separate,
        "Each file a session of its own, several at a time; lines begin with their file");
    addFormedOption(command, "--jobs", decode.jobs, CountForm,
        "With --separate: so many files at a time (default: as many as processors)");
}

void addView(CLI::App& program, Arguments& arguments)
{
    CLI::App& command = *program.add_subcommand(
        "view", "Browse a recording or a snapshot in the screens; a recording plays, pauses, steps and seeks");
    command.callback([&arguments] { arguments.job = Job::View; });
    addCommon(command, arguments);
    addScreens(command, arguments);
    addFormedOption(command, "FILE", arguments.view.file, FileForm, "A capture, a snapshot or a DLF file")
        ->required()
        ->type_name("");
    addTechnology(command, arguments.view.technology);
}

void addRecord(CLI::App& program, Arguments& arguments)
{
    CLI::App& command = *program.add_subcommand("record", "Record the live session into a capture file (pcap)");
    command.callback([&arguments] { arguments.job = Job::Record; });
    addCommon(command, arguments);
    RecordingFilesOptions& files = arguments.record.files;
    addFormedOption(command, "FILE", files.target, FileForm,
        "The capture file, a new one. A folder (or a new one: FOLDER/) takes numbered files, on from those that are "
        "there. - is standard output")
        ->required()
        ->type_name("");
    command.add_flag("--overwrite", files.overwrite, "Write over the capture file, where it is there");
    addFormedOption(command, "--rollover", files.largestFile, SizeForm,
        "Begin a further file before one has more bytes than this, such as 100M");
    addFormedOption(command, "--rollover-time", files.longestFile, DurationForm,
        "Begin a further file after this time, such as 1h");
    addFormedOption(
        command, "--keep", files.keep, CountForm, "Of the numbered files keep the last so many, remove the older ones");
    addLimits(command, arguments.record.count, "End after this many messages", arguments.record.duration);
}

void addChannel(CLI::App& program, Arguments& arguments)
{
    ChannelOptions& channel = arguments.channel;
    CLI::App& command = *program.add_subcommand("channel", "Print the bands and frequencies of a channel number");
    command.callback([&arguments] { arguments.job = Job::Channel; });
    addVersion(command);
    addFormedOption(command, "TECH", channel.technology, ChannelTechnologyForm, "Whose channel")->required();
    addFormedOption(command, "NUMBER", channel.number, ChannelForm, "A downlink or uplink channel number");
    addFormedOption(command, "--mhz", channel.mhz, FrequencyForm,
        "Instead of a number: a downlink or uplink centre frequency in MHz");
    command.add_option("--band", channel.band, "Only this band, such as 3 or 'DCS 1800'")->type_name("BAND");
    addFormedOption(
        command, "--format", channel.format, ChannelFormatForm, "How the bands are printed (default: text)");
}

void addMark(CLI::App& program, Arguments& arguments)
{
    CLI::App& command = *program.add_subcommand("mark", "Write a bookmark of this moment into a running recording");
    command.callback([&arguments] { arguments.job = Job::Mark; });
    addCommon(command, arguments);
    addFormedOption(command, "TEXT", arguments.mark.note, NoteForm, "What there is to note")->required()->type_name("");
    addFormedOption(command, "--recording", arguments.mark.recording, FileForm,
        "The recording beside which it is written (default: that of the running recorder)");
}

void addReport(CLI::App& program, Arguments& arguments)
{
    ReportOptions& report = arguments.report;
    CLI::App& command =
        *program.add_subcommand("report", "Write recordings as one HTML page: levels, cells, events and findings");
    command.callback([&arguments] { arguments.job = Job::Report; });
    addCommon(command, arguments);
    command
        .add_option("FILE", report.files,
            "The recordings. Files that `record` has numbered (drive.pcap, drive-2.pcap) are one recording; others "
            "stand side by side. - is standard input")
        ->required()
        ->type_name("");
    addFormedOption(command, "-o,--output", report.output, FileForm,
        "The page; a report that is there is overwritten, any other file is not. - is standard output")
        ->required();
    addTechnology(command, report.technology);
    addRepeatedOption(
        command, "--threshold", [&report](const std::string& text) { return report.thresholds.set(text); },
        "Set what a finding depends on; may be given several times")
        ->type_name("NAME=VALUE");
}

/// What no single option can tell.
void checkTogether(const Arguments& arguments)
{
    if (arguments.job == Job::Channel && arguments.channel.number.has_value() == arguments.channel.mhz.has_value())
        throw CLI::ValidationError("channel", "takes either a channel NUMBER or --mhz FREQUENCY");
    checkOutput(arguments.decode.output);
    checkOutput(arguments.watch.output);
    if (arguments.decode.each && arguments.decode.output.format != OutputFormat::Json)
        throw CLI::ValidationError("--each", "goes with --format json only");
    if (arguments.decode.jobs && !arguments.decode.separate)
        throw CLI::ValidationError("--jobs", "goes with --separate only");
    if (arguments.decode.separate && arguments.logFile)
        throw CLI::ValidationError("--log", "takes the lines of one session, not those of --separate");
    const RecordingFilesOptions& files = arguments.record.files;
    if (files.target == "-" && (files.largestFile || files.longestFile || files.keep))
        throw CLI::ValidationError(files.largestFile ? "--rollover"
                : files.longestFile                  ? "--rollover-time"
                                                     : "--keep",
            "standard output is one stream, not several files");
}

} // namespace

std::optional<int> readArguments(int argc, char** argv, Arguments& arguments)
{
    CLI::App program(Description, "spectrel");
    program.footer(Environment);
    program.require_subcommand(0, 1);
    addCommon(program, arguments);
    addScreens(program, arguments);
    addWatch(program, arguments);
    addDecode(program, arguments);
    addView(program, arguments);
    addRecord(program, arguments);
    addChannel(program, arguments);
    addMark(program, arguments);
    addReport(program, arguments);
    try {
        program.parse(argc, argv);
        checkTogether(arguments);
    } catch (const CLI::Success& answered) {
        program.exit(answered); // --help and --version, on standard output
        if (std::cout.flush())
            return ExitStatus::Done;
        report("standard output: cannot be written");
        return ExitStatus::Failed;
    } catch (const CLI::ParseError& error) {
        std::cerr << "spectrel: " << error.what() << " (see spectrel --help)\n";
        return ExitStatus::WrongUsage;
    }
    return std::nullopt;
}

} // namespace spectrel
