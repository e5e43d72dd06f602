#include "CommandLine/Output/EventJson.h"

#include "CommandLine/Output/CellJson.h"
#include "CommandLine/Output/JsonWriter.h"

namespace spectrel {

namespace {

void appendEvidence(const std::vector<Evidence>& evidence, TimeForm form, std::string& out)
{
    appendJsonArray(evidence, out, [&](const Evidence& each) {
        JsonObjectWriter object(out);
        object.text("path", each.path);
        object.text("value", each.value);
        object.key("time") += jsonTimeText(each.time, form);
    });
}

void appendCause(const EventCause& cause, TimeForm form, std::string& out)
{
    JsonObjectWriter object(out);
    object.text("kind", causeKindName(cause.kind));
    if (cause.kind == CauseKind::Reselection)
        object.text("rule", causeRuleName(cause.rule));
    object.text("text", cause.text);
    appendEvidence(cause.evidence, form, object.key("evidence"));
}

void addCell(JsonObjectWriter& object, std::string_view key, const std::optional<Cell>& cell)
{
    if (cell)
        appendCellJson(*cell, {}, object.key(key));
}

} // namespace

void appendEventJson(const Event& event, TimeForm form, std::string& out)
{
    JsonObjectWriter object(out);
    object.key("n") += std::to_string(event.n);
    object.key("time") += jsonTimeText(event.time, form);
    object.text("event", eventKindName(event.kind));
    object.text("text", event.text);
    addCell(object, "from", event.fromCell);
    addCell(object, "to", event.toCell);
    if (event.fromCell)
        appendJsonArray(event.change, object.key("change"), [&out](std::string_view key) { appendJsonText(key, out); });
    if (event.cause)
        appendCause(*event.cause, form, object.key("cause"));
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
        appendEvidence(event.evidence, form, object.key("evidence"));
}

} // namespace spectrel
