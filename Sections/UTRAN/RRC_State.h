#pragma once

#include "LogGenerator/Template/RecordSection.h"
#include "Values/Description.h"

#include <string>

namespace spectrel {

/// The mode of the radio resource control (3GPP TS 25.331, 7.1).
///
/// A short record is reported in the log and decoded all the same, unlike any other section's. Each record's outcome
/// goes to the diagnostic log.
class RRC_State final : public SectionOf<RRC_State> {
    static constexpr std::size_t ExpectedLength = 15;
    static constexpr std::uint8_t Valid = 1; // of the byte that says whether the mode may be used
    static constexpr std::uint8_t NoMode = 255;
    static constexpr CodeTexts<6> Modes {{{0, "Disconnected"}, {1, "Connecting"}, {2, "Cell Fach"}, {3, "Cell DCH"},
                                             {4, "Cell PCH"}, {5, "Cell URA PCH"}},
        "Unknown RRC Mode"};

    void storeMode(RecordView record)
    {
        if (record.size() < ExpectedLength)
            SPECTREL_LOG(log(), Priority::Warning, "LogCode_0xD0E0 is length is %ld expected size %ld",
                static_cast<long>(record.size()), static_cast<long>(ExpectedLength));
        const std::uint8_t mode = record.u8(13) == Valid ? record.u8(14) : NoMode;
        const std::string_view name = textOf(Modes, mode);
        storeText("State", name);
        if (DiagnosticLog* const diagnostics = diagnosticLog())
            diagnostics->write("Display Dict = " + describe(displayed()) + ", rrc mode = " + std::to_string(mode) + " "
                + std::string(name));
    }

    static constexpr std::array<RecordLayout, 1> Layouts {{
        {.code = 0xD0E0, .hook = hook<&RRC_State::storeMode>},
    }};

public:
    using SectionOf::SectionOf;
    static constexpr SectionDescription Description {
        .name = "RRC Info", .layouts = Layouts, .unknownCode = UnknownCode::Ignored};
};

} // namespace spectrel
