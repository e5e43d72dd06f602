#include "CommandLine/Output/EventJson.h"

#include "CommandLine/Output/JsonText.h"

#include <charconv>
#include <chrono>
#include <cstdio>
#include <string_view>

namespace spectrel {

namespace {

/// Seconds since 1970 with six decimals.
std::string timeText(Moment time)
{
    const auto seconds = std::chrono::floor<std::chrono::seconds>(time);
    char text[40];
    std::snprintf(text, sizeof text, "%lld.%06lld", static_cast<long long>(seconds.time_since_epoch().count()),
        static_cast<long long>((time - seconds).count()));
    return text;
}

/// Writes an object's pairs in turn.
class ObjectWriter {
public:
    explicit ObjectWriter(std::string& out)
        : _out(out)
    {
        _out += '{';
    }
    ObjectWriter(const ObjectWriter&) = delete;
    ObjectWriter& operator=(const ObjectWriter&) = delete;
    ~ObjectWriter()
    {
        _out += '}';
    }

    std::string& key(std::string_view name)
    {
        if (!_isFirst)
            _out += ", ";
        _isFirst = false;
        appendJsonText(name, _out);
        _out += ": ";
        return _out;
    }
    void text(std::string_view name, std::string_view value)
    {
        if (!value.empty())
            appendJsonText(value, key(name));
    }
    /// Without exponents and needless digits.
    void number(std::string_view name, double value)
    {
        char digits[400];
        const auto end = std::to_chars(digits, digits + sizeof digits, value, std::chars_format::fixed);
        key(name).append(digits, end.ptr);
    }
    template <typename Number> void number(std::string_view name, const std::optional<Number>& value)
    {
        if (value)
            number(name, static_cast<double>(*value));
    }

private:
    std::string& _out;
    bool _isFirst = true;
};

void appendCell(const Cell& cell, std::string& out)
{
    ObjectWriter object(out);
    object.text("technology", radioTechnologyName(cell.technology));
    object.text("plmn", cell.plmn);
    object.text("operator", cell.operatorName);
    object.number("area", cell.area);
    object.number("cell", cell.cell);
    object.number("site", cell.site);
    object.number("rnc", cell.rnc);
    object.number("sector", cell.sector);
    object.number("id", cell.id);
    object.number("channel", cell.channel);
    object.text("band", cell.band);
    object.number("downlinkMHz", cell.downlinkMHz);
    object.number("uplinkMHz", cell.uplinkMHz);
    object.number("bandwidthMHz", cell.bandwidthMHz);
    std::string levels;
    {
        ObjectWriter inner(levels);
        for (std::size_t level = 0; level < LevelCount; ++level)
            inner.number(levelName(static_cast<Level>(level)), cell.levels[level]);
    }
    if (levels != "{}")
        object.key("levels") += levels;
}

void appendEvidence(const std::vector<Evidence>& evidence, std::string& out)
{
    out += '[';
    for (const Evidence& each : evidence) {
        if (&each != &evidence.front())
            out += ", ";
        ObjectWriter object(out);
        object.text("path", each.path);
        object.text("value", each.value);
        object.key("time") += timeText(each.time);
    }
    out += ']';
}

void appendCause(const EventCause& cause, std::string& out)
{
    ObjectWriter object(out);
    object.text("kind", causeKindName(cause.kind));
    if (cause.kind == CauseKind::Reselection)
        object.text("rule", causeRuleName(cause.rule));
    object.text("text", cause.text);
    appendEvidence(cause.evidence, object.key("evidence"));
}

void appendChange(const std::vector<std::string_view>& keys, std::string& out)
{
    out += '[';
    for (const std::string_view& key : keys) {
        if (&key != &keys.front())
            out += ", ";
        appendJsonText(key, out);
    }
    out += ']';
}

void addCell(ObjectWriter& object, std::string_view key, const std::optional<Cell>& cell)
{
    if (cell)
        appendCell(*cell, object.key(key));
}

} // namespace

void appendEventJson(const Event& event, std::string& out)
{
    ObjectWriter object(out);
    object.key("n") += std::to_string(event.n);
    object.key("time") += timeText(event.time);
    object.text("event", eventKindName(event.kind));
    object.text("text", event.text);
    addCell(object, "from", event.fromCell);
    addCell(object, "to", event.toCell);
    if (event.fromCell)
        appendChange(event.change, object.key("change"));
    if (event.cause)
        appendCause(*event.cause, object.key("cause"));
    object.text("context", event.context);
    object.text("from", event.from);
    object.text("to", event.to);
    addCell(object, "cell", event.cell);
    object.text("reason", event.reason);
    object.text("note", event.note);
    object.text("condition", event.condition);
    object.number("value", event.value);
    object.text("finding", event.finding);
    object.number("seconds", event.seconds);
    if (event.kind == EventKind::Finding)
        appendEvidence(event.evidence, object.key("evidence"));
}

} // namespace spectrel
