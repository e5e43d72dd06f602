#pragma once

#include "LogGenerator/Template/Base.h"

#include <cstddef>

namespace spectrel {

/// What a section says to a log code that is not its own.
enum class UnknownCode : std::uint8_t { Logged, Ignored };

/// The one kind of record that a section decodes, and how the section is called in display and log.
struct RecordKind {
    std::string_view sectionName;
    std::uint32_t code;
    std::size_t minimumLength; // bytes, 13-byte header included; a shorter record changes nothing and logs nothing
    std::string_view trace; // logged on every call
    int tracePriority;
    UnknownCode unknownCode;
};

/// A section of one kind of record: traces every call and hands `decode` the records that are its own and long enough.
class RecordSection : public Base {
public:
    std::string_view getSectionName() const final
    {
        return _kind.sectionName;
    }
    std::vector<std::uint32_t> getLogCodeArray() const final
    {
        return {_kind.code};
    }
    void updateWithData(RecordView record, std::uint32_t logCode) final;

protected:
    /// `kind` outlives the section.
    RecordSection(const RecordKind& kind, ClassDictionary& dict, CodeDictionary& codeDict);

    /// A record of the section's code, at least the minimum length.
    virtual void decode(RecordView record) = 0;

    /// `clearElementsInArray` and `replaceArray` of the section's list; a node that is none loses them.
    void clearList();
    void replaceList(const List& elements);

private:
    const RecordKind& _kind;
};

} // namespace spectrel
