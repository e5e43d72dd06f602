#pragma once

#include "LogGenerator/Template/CellFields.h"
#include "LogGenerator/Template/CodeDictionary.h"
#include "LogGenerator/Template/Fields.h"
#include "Platform/Context.h"
#include "Records/Frame.h"
#include "Records/RecordView.h"
#include "Values/List.h"
#include "Values/Value.h"

#include <cstdint>
#include <span>
#include <string_view>
#include <vector>

namespace spectrel {

/// A section: decodes the records of a few log codes into its own node of the display dictionary.
///
/// Concrete sections derive from `SectionOf` (`RecordSection.h`), which decodes by a description.
class Base {
public:
    virtual ~Base() = default;
    Base(const Base&) = delete;
    Base& operator=(const Base&) = delete;

    /// The key under which the section's subtree stands in the template.
    virtual std::string_view getSectionName() const = 0;
    /// The log codes that the section wants, extra-stream codes with 0xFF0000 added. A code listed twice is delivered
    /// twice.
    virtual std::vector<std::uint32_t> getLogCodeArray() const = 0;
    /// One whole record, header included, of a code that the section subscribed to.
    virtual void updateWithData(RecordView record, std::uint32_t logCode) = 0;

    /// Binds the section to its node of the current display and logs its name.
    void updateSectionRef(Value node);
    /// Subscribes the section to its codes, in their order, and logs their number.
    void updateLogCodeDict(CodeDictionary& codeDict);

    /// Empties a displayed list under `ArrayLock`.
    static void clearElementsInArray(List& array);
    /// Refills a displayed list under `ArrayLock`, so that no half-filled one is ever shown.
    static void replaceArray(List& array, const List& elements);

    /// Energy ratio in whole decibels.
    ///
    /// Units:  `ratio` is linear, 524288 (2^19) being 0 dB; the result is in dB, -31 to 0.
    /// Shape:  the first rung of a descending ladder that `ratio` exceeds.
    /// Errors: none. 705 and below give 0, the same as full scale: kept on purpose.
    /// Source: 10*log10(ratio / 2^19) rounded down; the lower rungs drift off the curve and stay so.
    static std::int16_t lookUpECNO(std::uint32_t ratio);

protected:
    /// The context outlives the section.
    explicit Base(const Context& context)
        : _context(context)
    {
    }
    SystemLog& log() const
    {
        return _context.log;
    }
    /// Null when nobody listens.
    DiagnosticLog* diagnosticLog() const
    {
        return _context.diagnosticLog;
    }
    void enterInto(ClassDictionary& dict, CodeDictionary& codeDict);

    /// The node that the section shows its values in; absent until the display is built.
    const Value& displayed() const
    {
        return sectionRef;
    }
    /// Keyed stores into the section's dictionary; silently lost while there is none.
    void storeText(std::string_view key, std::string_view text);
    void store(std::string_view key, const Value& value);
    void removeKey(std::string_view key);
    /// Stores the fields in table order.
    void storeFields(RecordView record, std::span<const Field> fields);
    /// Stores a cell's fields in table order; the failures are logged also when there is no dictionary.
    void storeCellFields(const Dictionary& cell, std::span<const CellField> fields);

    /// `clearElementsInArray` and `replaceArray` of the section's list; silently lost while there is none.
    void clearList();
    void replaceList(const List& elements);

    /// "Received an unknown log message: %d", priority 3.
    void logUnknownMessage(std::uint32_t logCode) const;

private:
    const Context& _context;
    Value sectionRef; // a dictionary or a list of the current display; absent until the display is built
};

} // namespace spectrel
