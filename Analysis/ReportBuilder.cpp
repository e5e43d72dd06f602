#include "Analysis/ReportBuilder.h"

#include "Analysis/DisplayReading.h"

#include <algorithm>
#include <limits>
#include <tuple>
#include <utility>

namespace spectrel {

namespace {

/// Whether a list's cell is this one: GSM cells whose colour codes are not known go by their channel alone.
bool isListedAs(const Cell& listed, const Cell& cell)
{
    if (isSameCell(listed, cell))
        return true;
    return listed.technology == RadioTechnology::GSM && cell.technology == RadioTechnology::GSM && listed.channel
        && listed.channel == cell.channel && (!listed.id || !cell.id);
}

void takeChannel(Cell& cell, const Cell& from)
{
    cell.channel = from.channel;
    cell.band = from.band;
    cell.downlinkMHz = from.downlinkMHz;
    cell.uplinkMHz = from.uplinkMHz;
    for (const CellKey key : {CellKey::Channel, CellKey::Band, CellKey::DownlinkMHz, CellKey::UplinkMHz}) {
        const auto position = static_cast<std::size_t>(key);
        cell.origins[position] = from.origins[position];
    }
}

void addNeighbour(Cell&& cell, CellReport& report)
{
    const auto isThis = [&cell](const Cell& other) { return isListedAs(cell, other); };
    if ((report.serving && isThis(*report.serving)) || std::ranges::any_of(report.active, isThis))
        return;
    const auto twin = std::ranges::find_if(report.neighbours, isThis);
    if (twin == report.neighbours.end()) {
        report.neighbours.push_back({std::move(cell), std::nullopt});
    } else if (cell.stored > twin->stored || (cell.strength() && !twin->strength())) {
        static_cast<Cell&>(*twin) = std::move(cell);
    }
}

void addList(DisplayReading& reading, CellList& list, const Value& display, CellReport& report)
{
    const bool isSameChannel = list.row().channelContainer == SameChannel;
    const bool isData = list.row().technology == RadioTechnology::EVDO;
    const Cell* const ofChannel = isData ? reading.dataSector() : reading.serving();
    for (const ListedCell& listed : reading.cellsOf(list, display)) {
        if (isData && ofChannel && isSameCell(listed.cell, *ofChannel))
            continue; // stands there already
        Cell cell = listed.cell;
        if (isSameChannel && ofChannel && ofChannel->technology == cell.technology)
            takeChannel(cell, *ofChannel);
        if (listed.isActive)
            report.active.push_back(std::move(cell));
        else
            addNeighbour(std::move(cell), report);
    }
}

/// The sector first, then the other pilots that it is combined with.
void addDataSector(DisplayReading& reading, const Cell& sector, const Value& display, CellReport& report)
{
    report.active.push_back(sector);
    for (CellList& list : reading.lists()) {
        if (list.row().technology == RadioTechnology::EVDO && reading.isCurrent(list))
            addList(reading, list, display, report);
    }
}

void compareWithServing(NeighbourCell& cell, const Cell* serving)
{
    if (serving && serving->technology == cell.technology && serving->strength() && cell.strength())
        cell.difference = *cell.strength() - *serving->strength();
}

/// Strongest first, those without a level last; equals by channel, then id.
bool stands(const NeighbourCell& left, const NeighbourCell& right)
{
    const auto rank = [](const NeighbourCell& cell) {
        constexpr double Weakest = -std::numeric_limits<double>::infinity();
        constexpr std::uint32_t Last = std::numeric_limits<std::uint32_t>::max();
        return std::tuple(-cell.strength().value_or(Weakest), cell.channel.value_or(Last), cell.id.value_or(Last));
    };
    return rank(left) < rank(right);
}

} // namespace

void buildReport(DisplayReading& reading, const Value& display, CellReport& report)
{
    reading.fillIn(report);
    report.active.clear();
    report.neighbours.clear();
    const Cell* const serving = reading.serving();
    report.serving = serving ? std::optional(*serving) : std::nullopt;
    for (const ListRole role : {ListRole::Active, ListRole::BySetName, ListRole::Neighbours}) {
        for (CellList& list : reading.lists()) {
            if (list.row().role == role && list.row().technology != RadioTechnology::EVDO && reading.isCurrent(list))
                addList(reading, list, display, report);
        }
    }
    if (const Cell* const sector = reading.dataSector())
        addDataSector(reading, *sector, display, report);
    for (NeighbourCell& cell : report.neighbours)
        compareWithServing(cell, serving);
    std::ranges::stable_sort(report.neighbours, stands);
}

} // namespace spectrel
