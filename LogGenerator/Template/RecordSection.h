#pragma once

#include "LogGenerator/Template/Base.h"
#include "LogGenerator/Template/CellFields.h"
#include "LogGenerator/Template/Fields.h"
#include "LogGenerator/Template/RepeatedGroup.h"
#include "LogGenerator/Template/SectionRegistry.h"
#include "Platform/SystemLog.h"

#include <algorithm>
#include <array>
#include <cstddef>
#include <span>

namespace spectrel {

class RecordSection;

/// What a section does with a record beyond its tables.
using Hook = void (*)(RecordSection& section, RecordView record);

/// Where the entries of a list section stand in a record, and the fields of each.
struct EntryTable {
    RepeatedGroup (*group)(RecordView record) = nullptr;
    std::span<const Field> fields {};
};

/// How a section decodes the records of one log code. What is given is done, in the order of the members.
struct RecordLayout {
    std::uint32_t code;
    std::size_t minimumLength = 0; // bytes, 13-byte header included; a shorter record changes nothing and logs nothing
    std::span<const Field> fields {}; // written into the section's dictionary
    EntryTable entries {}; // replace the section's list
    CellTable cells {}; // of the cell-information record
    Hook hook = nullptr;
};

/// What a section does with a log code that is not its own.
enum class UnknownCode : std::uint8_t {
    Logged,
    Ignored,
    DecodedAsFirst, // as if it were the first of its own
};

/// A section as a table: how display and log call it, and what it decodes.
struct SectionDescription {
    std::string_view name; // in the template
    std::string_view trace {}; // logged on every call; the name where it is empty
    std::span<const RecordLayout> layouts {}; // in the order of subscription
    UnknownCode unknownCode = UnknownCode::Logged;
    int tracePriority = Priority::Warning;
};

/// A section that does as its description says.
class RecordSection : public Base {
public:
    std::string_view getSectionName() const final
    {
        return _description.name;
    }
    std::vector<std::uint32_t> getLogCodeArray() const final;
    void updateWithData(RecordView record, std::uint32_t logCode) final;

protected:
    /// `description` and `registry` outlive the section.
    RecordSection(const SectionDescription& description, SectionRegistry& registry);

    PropertyListPayloads& payloads()
    {
        return _registry.payloads;
    }

private:
    const RecordLayout* layoutOf(std::uint32_t logCode) const;
    void decode(RecordView record, const RecordLayout& layout);
    void showCells(RecordView record, const CellTable& cells);
    void listNeighborCells(const CellInfoArrayReader& reader, const CellTable& cells);

    const SectionDescription& _description;
    SectionRegistry& _registry;
};

/// The base of a concrete section, which has a `static constexpr SectionDescription Description`.
template <typename Concrete> class SectionOf : public RecordSection {
public:
    explicit SectionOf(SectionRegistry& registry)
        : RecordSection(Concrete::Description, registry)
    {
    }
};

/// A text as a template's argument.
template <std::size_t Size> struct TextArgument {
    constexpr TextArgument(const char (&text)[Size])
    {
        std::ranges::copy(text, characters);
    }
    constexpr std::string_view view() const
    {
        return {characters, Size - 1};
    }

    char characters[Size];
};

/// What a section without a layout has.
inline constexpr std::array<RecordLayout, 0> NoLayouts {};

/// A section that differs from others in its name and trace only: `using BLER = PlainSection<"BLER", "BLER">;`. Without
/// layouts it keeps its place on the screen and logs its line.
template <TextArgument Name, TextArgument Trace, const auto& Layouts = NoLayouts>
class PlainSection final : public SectionOf<PlainSection<Name, Trace, Layouts>> {
public:
    using SectionOf<PlainSection>::SectionOf;
    static constexpr SectionDescription Description {.name = Name.view(),
        .trace = Trace.view(),
        .layouts = Layouts,
        .unknownCode = Layouts.empty() ? UnknownCode::Ignored : UnknownCode::Logged};
};

template <auto Method> struct HookTo;
template <typename Section, void (Section::*Method)(RecordView)> struct HookTo<Method> {
    static void call(RecordSection& section, RecordView record)
    {
        (static_cast<Section&>(section).*Method)(record);
    }
};
/// A section's own operation as a hook: `hook<&BLER::storeChannels>`.
template <auto Method> inline constexpr Hook hook = &HookTo<Method>::call;

} // namespace spectrel
