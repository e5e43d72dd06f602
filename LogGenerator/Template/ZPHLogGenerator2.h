#pragma once

#include "LogGenerator/Template/ClassIndex.h"
#include "LogGenerator/Template/ZPHLogGenerator.h"

#include <memory>
#include <string>

namespace spectrel {

/// The template-driven generator: cuts each message into one log record, hands it to the sections subscribed to its
/// code, and builds the display by copying a template whose named subtrees belong to the sections.
///
/// Message: a 2-byte wrapper when byte 0 is 0x81, then the record: type byte (0x01, or 0xFF for the extra stream),
/// 16-bit item length, 16-bit log code, 8-byte timestamp, payload; little-endian.
class ZPHLogGenerator2 : public ZPHLogGenerator {
public:
    ~ZPHLogGenerator2() override;

    void updateState(Dictionary& state, ByteView data) override;
    Value generateLogUsingState(Dictionary& state) override;
    DictionaryRef getStartCommand() override;
    void takeOver(LogGenerator* predecessor, Dictionary& state) override;

    /// Frames one message and delivers its record. May throw what a section's reader throws.
    void updateWithData(ByteView data);
    /// The state's display. The call that builds it answers with an absent value, on purpose; so does one that finds no
    /// template.
    Value getDisplayFromState(Dictionary& state);
    /// The display copy of a template object; binds each section to the copy of its subtree. Absent for an object that
    /// templates do not have.
    Value processTemplate(const Value& object);
    /// Walks a display object and logs every value that is no string, dictionary or list.
    void printDict(const Value& object) const;

protected:
    /// A generator stays uninitialised until `initWithPListName` runs; it then knows no codes and builds no display,
    /// but answers every operation.
    using ZPHLogGenerator::ZPHLogGenerator;
    void initWithPListName(std::string newPListName, std::shared_ptr<ClassIndex> cIndexObj);

private:
    void bindSections(const Value& templateObject, const Value& displayObject);

    std::string pListName;
    std::shared_ptr<ClassIndex> cIndex;
};

} // namespace spectrel
