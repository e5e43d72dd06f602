#include "CommandLine/Output/CellJson.h"

#include "CommandLine/Output/JsonWriter.h"

#include <algorithm>
#include <chrono>
#include <cmath>

namespace spectrel {

namespace {

std::optional<double> ageOf(const Cell& cell, std::optional<Moment> now)
{
    if (!now)
        return std::nullopt;
    return static_cast<double>(std::max<std::int64_t>((*now - cell.stored).count(), 0)) / 1e6;
}

/// Rates are no more exact than their times.
std::optional<double> thousandths(std::optional<double> value)
{
    return value ? std::optional(std::round(*value * 1000) / 1000) : value;
}

void appendLevels(const Cell& cell, JsonObjectWriter& object)
{
    if (std::ranges::none_of(cell.levels, [](const auto& level) { return level.has_value(); }))
        return;
    JsonObjectWriter levels(object.key("levels"));
    for (std::size_t level = 0; level < LevelCount; ++level)
        levels.number(levelName(static_cast<Level>(level)), cell.levels[level]);
}

bool isKnown(const Cell& cell, CellKey key)
{
    switch (key) {
    case CellKey::Band:
        return !cell.band.empty();
    case CellKey::DownlinkMHz:
        return cell.downlinkMHz.has_value();
    case CellKey::UplinkMHz:
        return cell.uplinkMHz.has_value();
    default:
        return static_cast<bool>(cell.origin(key));
    }
}

void appendSources(const Cell& cell, const Analysis& analysis, JsonObjectWriter& object)
{
    JsonObjectWriter sources(object.key("sources"));
    for (std::size_t position = 0; position < CellKeyCount; ++position) {
        const auto key = static_cast<CellKey>(position);
        if (isKnown(cell, key))
            sources.text(cellKeyName(key), analysis.pathOf(cell.origin(key)));
    }
}

void appendContext(const DataContext& context, std::string& out)
{
    JsonObjectWriter object(out);
    object.text("name", context.name);
    object.text("state", context.state);
    object.number("downlinkKbps", thousandths(context.downlinkKbps));
    object.number("uplinkKbps", thousandths(context.uplinkKbps));
}

} // namespace

void appendCellJson(const Cell& cell, const CellDetails& details, std::string& out)
{
    JsonObjectWriter object(out);
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
    appendLevels(cell, object);
    object.number("age", ageOf(cell, details.now));
    if (details.sources)
        appendSources(cell, *details.sources, object);
}

void appendReportJson(
    const CellReport& report, const Analysis& analysis, TimeForm form, bool withSources, std::string& out)
{
    const CellDetails details {report.time, withSources ? &analysis : nullptr};
    const auto appendCell = [&](const Cell& cell) { appendCellJson(cell, details, out); };
    JsonObjectWriter object(out);
    object.key("n") += std::to_string(report.n);
    object.key("time") += jsonTimeText(report.time, form);
    object.text("connection", report.connection ? connectionName(*report.connection) : std::string_view());
    object.text("registration", report.registration);
    if (report.serving) {
        object.key("serving");
        appendCell(*report.serving);
    }
    appendJsonArray(report.active, object.key("active"), appendCell);
    appendJsonArray(report.neighbours, object.key("neighbours"), appendCell);
    if (!report.contexts.empty())
        appendJsonArray(
            report.contexts, object.key("contexts"), [&](const DataContext& context) { appendContext(context, out); });
    if (!withSources || (!report.connection && report.registration.empty()))
        return;
    JsonObjectWriter sources(object.key("sources"));
    if (report.connection)
        sources.text("connection", analysis.pathOf(report.connectionOrigin));
    if (!report.registration.empty())
        sources.text("registration", analysis.pathOf(report.registrationOrigin));
}

} // namespace spectrel
