#include "LogGenerator/Template/CellFields.h"

#include "LogGenerator/Template/Base.h"
#include "LogGenerator/Template/PropertyListReaders.h"
#include "Platform/SystemLog.h"
#include "Values/Dictionary.h"

namespace spectrel {

namespace {

void storeCellIn(Dictionary& section, const Dictionary& cell, std::span<const CellField> fields)
{
    TextBuffer buffer;
    for (const CellField& field : fields) {
        buffer.clear();
        if (const auto number = cell[field.cellKey].int32())
            section.setText(field.key, field.format(static_cast<std::uint32_t>(*number), buffer));
        else
            SPECTREL_LOG(Priority::Error, "%s", field.missing);
    }
}

bool holdsCells(const CellInfoArrayReader& reader)
{
    if (!reader.holdsAnything())
        SPECTREL_LOG(Priority::Error, "Failed to get Cell Array\n");
    return reader.holdsAnything();
}

} // namespace

void storeCell(const Dictionary& cell, std::span<const CellField> fields, const Value& sectionRef)
{
    Dictionary lost; // takes the values of a section that has no node
    const auto& section = sectionRef.dictionary();
    storeCellIn(section ? *section : lost, cell, fields);
}

void storeServingCell(RecordView record, std::initializer_list<std::string_view> technologies,
    std::span<const CellField> fields, const Value& sectionRef)
{
    const CellInfoArrayReader reader(record);
    if (!holdsCells(reader))
        return;
    if (const DictionaryRef cell = reader.firstServingCell(technologies))
        storeCell(*cell, fields, sectionRef);
}

void listNeighborCells(
    RecordView record, std::string_view technology, std::span<const CellField> fields, const Value& sectionRef)
{
    const CellInfoArrayReader reader(record);
    List lost;
    List& list = sectionRef.list() ? *sectionRef.list() : lost;
    Base::clearElementsInArray(list);
    if (!holdsCells(reader))
        return;
    List entries;
    for (const DictionaryRef& cell : reader.neighborCells(technology)) {
        auto entry = Dictionary::make();
        storeCellIn(*entry, *cell, fields);
        entries.append(entry);
    }
    Base::replaceArray(list, entries);
}

} // namespace spectrel
