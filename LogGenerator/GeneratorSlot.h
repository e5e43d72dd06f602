#pragma once

#include "LogGenerator/LogGenerator.h"

#include <memory>
#include <string>

namespace spectrel {

/// Holds the current generator and puts a new one (or none) in its place.
///
/// A new generator of the class that built the display takes the display over, so that values, history and open screens
/// stay; one of another class finds a state without "Template", "Display" and "Lookup". The history always stays.
class GeneratorSlot {
public:
    LogGenerator* get() const
    {
        return _generator.get();
    }
    LogGenerator* operator->() const
    {
        return _generator.get();
    }
    explicit operator bool() const
    {
        return _generator != nullptr;
    }

    /// `hasUnbuiltMessages`: messages were applied since the last display build. Where the successor cannot go on with
    /// them, they get a last history entry.
    void replace(std::unique_ptr<LogGenerator> successor, Dictionary& state, bool hasUnbuiltMessages);
    void clear()
    {
        _generator.reset();
    }

private:
    std::unique_ptr<LogGenerator> _generator;
    std::string _displayBuilder; // the class of the latest generator, also after it is gone
};

} // namespace spectrel
