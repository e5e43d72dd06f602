#pragma once

#include "LogGenerator/LogGenerator.h"

#include <memory>

namespace spectrel {

/// The dictionary-reporting baseband: every message is one property list, its whole labelled state, which becomes the
/// display. No template, no log codes, no DLF.
class GSMLogGenerator final : public LogGenerator {
public:
    explicit GSMLogGenerator(const Context& context);

    static std::unique_ptr<GSMLogGenerator> generator(const Context& context);
    std::string_view className() const override;

    /// A message that does not parse is an assertion failure and leaves no display.
    void updateState(Dictionary& state, ByteView data) override;
    Value generateLogUsingState(Dictionary& state) override;
    DictionaryRef getStartCommand() override;
    ListRef getSaveContentsFromState(const Dictionary& state) override;

    /// The single value of a dictionary that has exactly one entry; absent for anything else.
    static Value canCollapse(const Value& object);
    /// The display copy: values that are dictionaries of one entry, once they are copied themselves, give way to that
    /// entry's value, and every list loses its first element. Absent, after an assertion failure, for what is neither
    /// text nor container; such a value is left out of its container.
    static Value processObject(const Value& object, SystemLog& log);
};

} // namespace spectrel
