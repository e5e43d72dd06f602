#pragma once

#include "LogGenerator/Template/RecordSection.h"

#include <array>

namespace spectrel {

/// The GSM radio-resource state, the serving cell's level and quality, and whether discontinuous transmission (DTX) and
/// reception (DRX) are used.
class GSMRRInfo final : public SectionOf<GSMRRInfo> {
    /// Indexed by their code. The blanks inside three of them are shown.
    static constexpr std::array<std::string_view, 22> RRStates {{
        "RR_INACTIVE",
        "RR_GOING_ACTIVE",
        "RR_GOING_INACTIVE",
        "RR_CELL_SELECTION",
        "RR_PLMN_LIST_CONSTRUCTION",
        "RR_IDLE",
        "RR_CELL_RESELECTION",
        "RR_CONNECTION_PENDING",
        "RR_CHOOSE_CELL",
        "RR_DATA_TRANSFER",
        "RR_NO_CHANNELS",
        "RR_CONNECTION_RELEASE",
        "RR_EARLY_CAMPED_WAIT_FOR_SI",
        "RR_W2G_INTERRAT_HANDOVER_ PROGRESS",
        "RR_W2G_INTERRAT_RESELECTION_PROGRESS",
        "RR_WAIT_FOR_EARLY_PSCAN",
        "GRR51",
        "GRR52",
        "RR_G2W_INTERRAT_RESELECTION_PROGRESS",
        "RR_G2W_INTERRAT_HANDOVER_ PROGRESS",
        "RR_CELL_REEST",
        "RR_W2G_INTERRAT_CC_ORDER_ PROGRESS",
    }};

    static constexpr std::array<std::string_view, 2> Modes {{"Voice", "Data"}};
    static constexpr std::array<std::string_view, 2> OffOn {{"OFF", "ON"}};

    static std::string_view seconds(std::uint32_t value, TextBuffer& buffer)
    {
        return buffer.decimal(value).text(" sec").view();
    }

    /// Radio-resource state, in writing order.
    static constexpr std::array<Field, 4> StateFields {{
        {13, Width::U8, "RR State", named<RRStates>},
        {14, Width::U8, "RR Sub State", decimal},
        {15, Width::U8, "RR Status", decimal},
        {16, Width::U8, "RR Mode", flagged<Modes>},
    }};

    /// Measurement, in writing order.
    static constexpr std::array<Field, 3> MeasurementFields {{
        {15, Width::U8, "Serving Rx Level", decimal},
        {16, Width::U32, "Rx Quality Full", decimal},
        {20, Width::U32, "Rx Quality Sub", decimal},
    }};

    /// Discontinuous transmission.
    static constexpr std::array<Field, 1> DTXFields {{
        {19, Width::U8, "DTX Used", flagged<OffOn>},
    }};

    /// Discontinuous reception.
    static constexpr std::array<Field, 1> DRXFields {{
        {16, Width::U8, "DRX Used", seconds},
    }};

    static constexpr std::array<RecordLayout, 4> Layouts {{
        {.code = 0x512C, .minimumLength = 17, .fields = StateFields},
        {.code = 0x5137, .minimumLength = 29, .fields = MeasurementFields},
        {.code = 0x5072, .minimumLength = 20, .fields = DTXFields},
        {.code = 0x51F6, .minimumLength = 24, .fields = DRXFields},
    }};

public:
    using SectionOf::SectionOf;
    static constexpr SectionDescription Description {.name = "GSM RR Info", .trace = "GSMRRInfo", .layouts = Layouts};
};

} // namespace spectrel
