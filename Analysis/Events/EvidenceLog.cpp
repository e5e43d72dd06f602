#include "Analysis/Events/EvidenceLog.h"

#include "Monitor/DisplayOrder.h"
#include "Monitor/SpectrelModelNode.h"

#include <algorithm>
#include <charconv>
#include <span>

namespace spectrel {

namespace {

constexpr std::array<std::string_view, 9> LTEServingKeys {"E-ARFCN", "Physical Cell ID", "Serving Layer Priority",
    "Srxlev", "Num of Consecutive DRX Cycles of S < 0", "S Intra Search", "S Non Intra Search", "Average RSRP",
    "Average RSRQ"};
constexpr std::array<std::string_view, 2> LTEConnectedKeys {"E-ARFCN", "Serving Physical Cell ID"};
constexpr std::array<std::string_view, 1> LTECarrierKeys {"E-ARFCN"};
constexpr std::array<std::string_view, 4> LTENeighbourKeys {
    "Physical Cell ID", "Average RSRP", "Average RSRQ", "Srxlev"};
constexpr std::array<std::string_view, 8> LTECandidateKeys {
    "Candidate RAT Type", "Candidate Priority", "E ARFCN", "Cell ID", "U ARFCN", "PSC", "ARFCN", "BSIC ID"};
constexpr std::array<std::string_view, 2> GSMStateKeys {"RR State", "RR Mode"};
constexpr std::array<std::string_view, 5> GSMServingKeys {"ARFCN", "BSIC", "RSSI", "C1 Value", "C2 Value"};
constexpr std::array<std::string_view, 4> GSMNeighbourKeys {"ARFCN", "BSIC", "RSSI", "C1 Value"};
constexpr std::array<std::string_view, 4> GSMRankingKeys {"ARFCN", "BSIC", "RSSI", "Ranking Value"};
constexpr std::array<std::string_view, 1> UMTSStateKeys {"RRC State"};
constexpr std::array<std::string_view, 3> UMTSActiveKeys {"Scrambling Code", "RSCP", "Energy Per Chip"};
constexpr std::array<std::string_view, 7> UMTSRankingKeys {
    "Scrambling Code", "RSCP", "Energy Per Chip", "Downlink Frequency", "UARFCN", "Ranking Value", "Rank Cell RSCP"};
constexpr std::array<std::string_view, 1> StateKeys {"State"};
constexpr std::array<std::string_view, 4> UTRANNeighbourKeys {"UARFCN", "Cell ID", "Filter RSCP", "Status"};

struct SectionRow {
    std::string_view path; // of the dictionary, or of the list whose entries hold the keys
    bool isList;
    std::span<const std::string_view> keys;
};

/// In the order of `EvidenceSection`.
constexpr std::array<SectionRow, EvidenceSectionCount> Sections {{
    {"/Serving Cell Measurements", false, LTEServingKeys},
    {"/Connected mode LTE Intra-frequency Measurement", false, LTEConnectedKeys},
    {"/Neighbor Measurements", false, LTECarrierKeys},
    {"/Neighbor Cells List", true, LTENeighbourKeys},
    {"/Reselection Candidates List", true, LTECandidateKeys},
    {"/GSM/GSM RR Info", false, GSMStateKeys},
    {"/GSM/GSM Serving Cell", false, GSMServingKeys},
    {"/GSM/Neighboring Cells", true, GSMNeighbourKeys},
    {"/GSM/GSM Set", true, GSMRankingKeys},
    {"/UMTS/UMTS RR Info", false, UMTSStateKeys},
    {"/UMTS/Active Set", true, UMTSActiveKeys},
    {"/UMTS/UMTS Set", true, UMTSRankingKeys},
    {"/RRC Info", false, StateKeys},
    {"/Neighbor Cell List", true, UTRANNeighbourKeys},
    {"/1x", false, StateKeys},
    {"/EV-DO", false, StateKeys},
    {"/Call", false, StateKeys},
}};

const SectionRow& rowOf(EvidenceSection section)
{
    return Sections[static_cast<std::size_t>(section)];
}

std::size_t positionOf(EvidenceSection section, std::string_view key)
{
    const auto keys = rowOf(section).keys;
    return static_cast<std::size_t>(std::ranges::find(keys, key) - keys.begin());
}

std::optional<int> positionIn(std::string_view text)
{
    int number = 0;
    const auto end = std::from_chars(text.data(), text.data() + text.size(), number);
    return end.ec == std::errc() && end.ptr == text.data() + text.size() ? std::optional(number) : std::nullopt;
}

/// As the tree names what stands in the place.
std::string_view nameIn(const Journal::Place& place, std::string_view key)
{
    return place.isSorted ? sortedKeyName(key) : key;
}

std::string pathOf(const Journal::Place& place)
{
    return place.parent ? pathByAppending(pathOf(*place.parent), nameIn(*place.parent, place.key)) : "/";
}

} // namespace

const std::string& EvidenceSample::text(std::string_view key) const
{
    static const std::string None;
    const std::size_t position = positionOf(section, key);
    return position < rowOf(section).keys.size() ? texts[position] : None;
}

std::optional<double> EvidenceSample::number(std::string_view key) const
{
    std::string_view digits = text(key);
    if (digits.starts_with('+'))
        digits.remove_prefix(1);
    double number = 0;
    const auto end = std::from_chars(digits.data(), digits.data() + digits.size(), number);
    // "nan" reads as a number that is none.
    return end.ec == std::errc() && number == number ? std::optional(number) : std::nullopt;
}

Evidence EvidenceSample::evidence(std::string_view key) const
{
    const SectionRow& row = rowOf(section);
    const std::string container = row.isList ? pathByAppending(row.path, std::to_string(entry)) : std::string(row.path);
    return {pathByAppending(container, key), text(key), time};
}

void EvidenceLog::read(const AppliedMessage& message, const Journal& journal)
{
    const Journal::Place* place = nullptr;
    const Known* known = nullptr;
    for (const Journal::Change& change : journal.changes()) {
        if (!change.place)
            continue;
        if (change.place.get() != place) {
            place = change.place.get();
            known = &lookUp(change.place);
        }
        if (known->section < 0 || change.kind == Journal::Kind::Removed)
            continue;
        const auto section = static_cast<EvidenceSection>(known->section);
        const std::size_t position = positionOf(section, nameIn(*place, journal.keyOf(change)));
        if (position < rowOf(section).keys.size())
            sampleOf(*known, message).texts[position] = journal.valueOf(change);
    }
    if (_known.size() > _tidyAt)
        forgetLeftPlaces();
}

const EvidenceSample* EvidenceLog::latestBefore(EvidenceSection section, std::uint64_t n) const
{
    const Samples& all = samples(section);
    const auto found = std::find_if(all.rbegin(), all.rend(), [n](const EvidenceSample& each) { return each.n < n; });
    return found == all.rend() ? nullptr : &*found;
}

const EvidenceSample* EvidenceLog::latestWith(EvidenceSection section, std::string_view key, std::uint64_t upTo) const
{
    const Samples& all = samples(section);
    const auto found = std::find_if(all.rbegin(), all.rend(),
        [&](const EvidenceSample& each) { return each.n <= upTo && !each.text(key).empty(); });
    return found == all.rend() ? nullptr : &*found;
}

const EvidenceSample* EvidenceLog::latestOlder(EvidenceSection section, std::string_view key, Moment time) const
{
    const Samples& all = samples(section);
    const auto found = std::find_if(all.rbegin(), all.rend(),
        [&](const EvidenceSample& each) { return each.time < time && !each.text(key).empty(); });
    return found == all.rend() ? nullptr : &*found;
}

const EvidenceLog::Known& EvidenceLog::lookUp(const Journal::PlaceRef& place)
{
    const auto [found, isNew] = _known.try_emplace(place.get());
    if (isNew)
        found->second = classify(place);
    return found->second;
}

EvidenceLog::Known EvidenceLog::classify(const Journal::PlaceRef& place)
{
    const auto sectionAt = [](const std::string& path, bool isList) {
        const auto row = std::ranges::find_if(
            Sections, [&](const SectionRow& each) { return each.path == path && each.isList == isList; });
        return row == Sections.end() ? -1 : static_cast<int>(row - Sections.begin());
    };
    if (const auto entry = positionIn(place->key); entry && place->parent)
        return {place, sectionAt(pathOf(*place->parent), true), *entry};
    return {place, sectionAt(pathOf(*place), false), -1};
}

/// Places that nobody else holds have been left for good.
void EvidenceLog::forgetLeftPlaces()
{
    std::erase_if(_known, [](const auto& each) { return each.second.place.use_count() == 1; });
    _tidyAt = std::max<std::size_t>(256, 2 * _known.size());
}

EvidenceSample& EvidenceLog::sampleOf(const Known& known, const AppliedMessage& message)
{
    Samples& all = _samples[static_cast<std::size_t>(known.section)];
    if (!all.empty() && all.back().n == message.number && all.back().entry == known.entry)
        return all.back();
    while (all.size() > 1 && (all.front().time < message.time - Span || all.size() >= MaxSamples))
        all.pop_front();
    all.push_back({message.time, message.number, static_cast<EvidenceSection>(known.section), known.entry, {}});
    return all.back();
}

} // namespace spectrel
