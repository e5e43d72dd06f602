#include "CommandLine/Service/TruthFile.h"

#include <array>
#include <cstdio>
#include <string_view>

namespace spectrel {

namespace {

constexpr std::array<std::string_view, 4> Kinds {"reselection", "handover", "redirection", "service-lost"};
constexpr std::array<std::string_view, 5> Rules {
    "", "higher-priority", "equal-priority", "lower-priority", "not-suitable"};

std::string quoted(std::string_view word)
{
    return '"' + std::string(word) + '"';
}

std::string timeText(Moment time)
{
    const auto seconds = std::chrono::floor<std::chrono::seconds>(time);
    char text[40];
    std::snprintf(text, sizeof text, "%lld.%06lld", static_cast<long long>(seconds.time_since_epoch().count()),
        static_cast<long long>((time - seconds).count()));
    return text;
}

std::string cellText(const CellName& name)
{
    std::string text = "{\"technology\": " + quoted(name.technology) + ", \"channel\": " + std::to_string(name.channel)
        + ", \"id\": " + std::to_string(name.id);
    if (name.cell)
        text += ", \"cell\": " + std::to_string(*name.cell);
    return text + '}';
}

std::string causeText(const MoveCause& cause)
{
    std::string text = "{\"kind\": " + quoted(Kinds.at(static_cast<std::size_t>(cause.kind)));
    if (cause.rule != ReselectionRule::None)
        text += ", \"rule\": " + quoted(Rules.at(static_cast<std::size_t>(cause.rule)));
    return text + '}';
}

} // namespace

Result<std::unique_ptr<TruthFile>> TruthFile::create(const std::string& path)
{
    auto truth = std::unique_ptr<TruthFile>(new TruthFile(path));
    if (!truth->_file)
        return Failure::ofSystem();
    return truth;
}

void TruthFile::write(Moment time, const Move& move)
{
    _file << truthLine(time, move) << '\n';
}

Outcome TruthFile::finish()
{
    _file.close();
    if (!_file)
        return Failure::ofSystem();
    return Done();
}

std::string truthLine(Moment time, const Move& move)
{
    std::string line = "{\"time\": " + timeText(time);
    if (move.from)
        line += ", \"from\": " + cellText(*move.from);
    line += ", \"to\": " + cellText(move.to);
    if (move.cause)
        line += ", \"cause\": " + causeText(*move.cause);
    return line + '}';
}

} // namespace spectrel
