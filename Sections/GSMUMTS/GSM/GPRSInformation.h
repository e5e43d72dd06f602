#pragma once

#include "LogGenerator/Template/RecordSection.h"

#include <array>

namespace spectrel {

/// The packet parameters of the serving GSM cell, from seven records of which each carries a few.
class GPRSInformation final : public SectionOf<GPRSInformation> {
    static constexpr std::uint32_t NotAvailable = 255;

    static constexpr CodeTexts<3> SI13Positions {
        {{0, "Located on BCCH"}, {1, "Located on Extended BCCH"}, {NotAvailable, "Not Available"}}};
    static constexpr CodeTexts<4> NetworkControlOrders {
        {{0, "NC0"}, {1, "NC1"}, {2, "NC2"}, {NotAvailable, "Not Available"}}};
    static constexpr CodeTexts<3> PacketFlowContexts {
        {{0, "Not Supported"}, {1, "Supported"}, {NotAvailable, "Available"}}}; // not the others' text: kept on purpose
    static constexpr CodeTexts<9> AccessThresholds {{
        {0, "Barred (PKT access not allowed in the Cell)"},
        {1, "Barred"},
        {2, "Barred"},
        {3, "1 Only"},
        {4, "1 to 2"},
        {5, "1 to 3"},
        {6, "1 to 4"},
        {7, "Allowed"},
        {NotAvailable, "Not Available"},
    }};
    /// Waiting times (3GPP TS 44.060, table 12.24.2).
    static constexpr CodeTexts<8> T3192Times {{{0, "500 ms"}, {1, "1000 ms"}, {2, "1500 ms"}, {3, "0 ms"}, {4, "80 ms"},
                                                  {5, "120 ms"}, {6, "160 ms"}, {7, "200 ms"}},
        "?? ms"};
    static constexpr std::array<std::string_view, 3> OperatingModes {{"Class 1", "Class 2", "Class 3"}};
    static constexpr std::array<std::string_view, 2> BurstTypes {{"8-bit format", "11-bit format"}};
    static constexpr std::array<std::string_view, 2> Support {{"Not Supported", "Supported"}};
    static constexpr std::array<std::string_view, 2> Application {{"Not Applied", "Applied"}};

    static constexpr std::array<Field, 1> SI13Fields {{
        {14, Width::U8, "SI13 Position", named<SI13Positions>},
    }};

    static constexpr std::array<Field, 3> NetworkControlFields {{
        {15, Width::U8, "Network Control Order", named<NetworkControlOrders>},
        {13, Width::U8, "PFC Supported", named<PacketFlowContexts>},
        {14, Width::U8, "Priority Access Threshold", named<AccessThresholds>},
    }};

    static constexpr std::array<Field, 3> PacketCellOptionsFields {{
        {15, Width::U8, "T3192", named<T3192Times>},
        {17, Width::U8, "Access Burst Type", flagged<BurstTypes>},
        {16, Width::U8, "DRX Timer Max", decimal},
    }};

    static constexpr std::array<Field, 1> PBCCHFields {{
        {13, Width::U8, "PBCCH Present", decimal},
    }};

    static constexpr std::array<Field, 5> PacketMeasurementFields {{
        {16, Width::U8, "Ext Measurement Order", decimal},
        {13, Width::U8, "Packet PSI Status", decimal},
        {33, Width::U8, "Packet SI Status", flagged<Support>},
        {14, Width::U8, "Count LR", decimal},
        {15, Width::U8, "Count HR", decimal},
    }};

    static constexpr std::array<Field, 1> MeasurementFields {{
        {26, Width::U8, "Cell Reselect Hysteresis", flagged<Application>},
    }};

    static constexpr std::array<Field, 1> ServingPLMNFields {{
        {13, Width::U8, "Network Operating Mode", named<OperatingModes>},
    }};

    static constexpr std::array<RecordLayout, 7> Layouts {{
        {.code = 0x51F5, .minimumLength = 18, .fields = NetworkControlFields},
        {.code = 0x7135, .minimumLength = 32, .fields = ServingPLMNFields},
        {.code = 0x51F6, .minimumLength = 24, .fields = PacketCellOptionsFields},
        {.code = 0x51FB, .minimumLength = 34, .fields = PBCCHFields},
        {.code = 0x51FD, .minimumLength = 35, .fields = PacketMeasurementFields},
        {.code = 0x51F4, .minimumLength = 15, .fields = SI13Fields},
        {.code = 0x5137, .minimumLength = 29, .fields = MeasurementFields},
    }};

public:
    using SectionOf::SectionOf;
    static constexpr SectionDescription Description {
        .name = "GPRS Information", .trace = "GPRSInformation", .layouts = Layouts};
};

} // namespace spectrel
