#pragma once

#include "Records/RecordView.h"
#include "Values/Dictionary.h"

#include <cstddef>
#include <cstdint>
#include <string_view>

namespace spectrel {

/// Pilots and their strengths as the display shows them, in the record's order: one entry "INDEX;PN" each, besides the
/// mark that has them shown by PN alone.
class PilotList {
public:
    PilotList();
    void add(std::size_t index, std::uint16_t pn, std::string_view strength);
    /// The list, also when it is empty.
    Value pilots() const
    {
        return _pilots;
    }
    /// The list, or "(none)" when it is empty.
    Value pilotsOrNone() const;

private:
    DictionaryRef _pilots;
};

} // namespace spectrel
