#include "LogGenerator/Template/RecordSection.h"

#include <algorithm>

namespace spectrel {

RecordSection::RecordSection(const SectionDescription& description, SectionRegistry& registry)
    : Base(registry.context)
    , _description(description)
    , _registry(registry)
{
    enterInto(registry.classDict, registry.codeDictionary);
}

std::vector<std::uint32_t> RecordSection::getLogCodeArray() const
{
    std::vector<std::uint32_t> codes;
    for (const RecordLayout& layout : _description.layouts)
        codes.push_back(layout.code);
    return codes;
}

void RecordSection::updateWithData(RecordView record, std::uint32_t logCode)
{
    const std::string_view trace = _description.trace.empty() ? _description.name : _description.trace;
    SPECTREL_LOG(log(), _description.tracePriority, "%.*s", static_cast<int>(trace.size()), trace.data());
    if (const RecordLayout* const layout = layoutOf(logCode)) {
        if (record.size() >= layout->minimumLength)
            decode(record, *layout);
    } else if (_description.unknownCode == UnknownCode::Logged) {
        logUnknownMessage(logCode);
    }
}

const RecordLayout* RecordSection::layoutOf(std::uint32_t logCode) const
{
    const auto& layouts = _description.layouts;
    const auto layout = std::ranges::find(layouts, logCode, &RecordLayout::code);
    if (layout != layouts.end())
        return &*layout;
    return _description.unknownCode == UnknownCode::DecodedAsFirst ? &layouts.front() : nullptr;
}

void RecordSection::decode(RecordView record, const RecordLayout& layout)
{
    if (!layout.fields.empty())
        storeFields(record, layout.fields);
    if (layout.entries.group)
        replaceList(*entriesWithFields(record, layout.entries.group(record), layout.entries.fields));
    if (layout.cells.choice != CellChoice::None)
        showCells(record, layout.cells);
    if (layout.hook)
        layout.hook(*this, record);
}

void RecordSection::showCells(RecordView record, const CellTable& cells)
{
    const CellInfoArrayReader reader(record, payloads(), log());
    if (cells.choice == CellChoice::Neighbors)
        clearList(); // also when there is nothing to fill it with
    if (!reader.holdsAnything()) {
        if (cells.choice != CellChoice::EveryServing)
            SPECTREL_LOG(log(), Priority::Error, "Failed to get Cell Array\n");
        return;
    }
    if (cells.choice == CellChoice::Neighbors)
        return listNeighborCells(reader, cells);
    for (const DictionaryRef& cell : reader.servingCells(cells.technologies)) {
        storeCellFields(*cell, cells.fields);
        if (cells.choice == CellChoice::FirstServing)
            return;
    }
}

void RecordSection::listNeighborCells(const CellInfoArrayReader& reader, const CellTable& cells)
{
    List entries;
    for (const DictionaryRef& cell : reader.neighborCells(cells.technologies)) {
        auto entry = std::make_shared<Dictionary>();
        entry->reserve(cells.fields.size());
        storeCell(log(), *cell, cells.fields, *entry);
        entries.append(entry);
    }
    replaceList(entries);
}

} // namespace spectrel
