#include "Analysis/Events/MoveText.h"

#include <cstdio>

namespace spectrel {

namespace {

std::string_view technologyText(RadioTechnology technology)
{
    switch (technology) {
    case RadioTechnology::GSM:
        return "GSM";
    case RadioTechnology::UMTS:
        return "UMTS";
    case RadioTechnology::LTE:
        return "LTE";
    case RadioTechnology::CDMA:
        return "1x";
    case RadioTechnology::EVDO:
        return "EV-DO";
    }
    return "";
}

/// What the technology calls the identity that the phone hears first.
std::string idText(const Cell& cell)
{
    switch (cell.technology) {
    case RadioTechnology::GSM:
        return "BSIC " + std::to_string(*cell.id / 8) + "-" + std::to_string(*cell.id % 8);
    case RadioTechnology::UMTS:
        return "PSC " + std::to_string(*cell.id);
    case RadioTechnology::LTE:
        return "PCI " + std::to_string(*cell.id);
    case RadioTechnology::CDMA:
    case RadioTechnology::EVDO:
        return "PN " + std::to_string(*cell.id);
    }
    return "";
}

std::string_view movedText(const EventCause& cause)
{
    switch (cause.kind) {
    case CauseKind::Reselection:
        return "Reselection";
    case CauseKind::Handover:
        return "Handover";
    case CauseKind::Redirection:
        return "Redirection";
    case CauseKind::ServiceLost:
        return "Move after loss of service";
    case CauseKind::Unknown:
        break;
    }
    return "Move";
}

} // namespace

std::string numberText(double number)
{
    char text[40];
    std::snprintf(text, sizeof text, "%.2f", number);
    std::string digits = text;
    digits.erase(digits.find_last_not_of('0') + 1);
    if (digits.ends_with('.'))
        digits.pop_back();
    return digits == "-0" ? "0" : digits;
}

std::string cellText(const Cell& cell)
{
    std::string text(technologyText(cell.technology));
    if (cell.id)
        text += " " + idText(cell);
    else if (cell.cell)
        text += " cell " + std::to_string(*cell.cell);
    if (cell.channel)
        text += " on " + std::to_string(*cell.channel);
    if (!cell.band.empty())
        text += cell.technology == RadioTechnology::GSM ? " (" + cell.band + ")" : " (band " + cell.band + ")";
    return text;
}

std::string strengthText(const Cell& cell)
{
    const auto level = cell.strengthLevel();
    if (!level)
        return "";
    return std::string(levelName(*level)) + " " + numberText(*cell.strength()) + " " + std::string(levelUnit(*level));
}

std::string moveText(const Event& event)
{
    const std::string strength = strengthText(*event.toCell);
    const std::string to = cellText(*event.toCell) + (strength.empty() ? "" : ", " + strength);
    if (!event.fromCell)
        return "First cell: " + to;
    std::string text = std::string(movedText(*event.cause)) + " from " + cellText(*event.fromCell) + " to " + to;
    if (event.cause->kind == CauseKind::Reselection && !event.cause->text.empty())
        text += ": " + event.cause->text;
    return text;
}

} // namespace spectrel
