#pragma once

#include "LogGenerator/Template/RecordSection.h"
#include "Sections/LTE/Levels.h"

#include <array>

namespace spectrel {

/// The serving cell as idle mode measures it and judges it for reselection.
class ServingCellMeasurement final : public SectionOf<ServingCellMeasurement> {
    static constexpr Formatter RSRP = fineLevel<4, -140, LevelUnit::dBm>;
    static constexpr Formatter RSRQ = fineLevel<4, -30, LevelUnit::dB>;
    static constexpr Formatter RSSI = fineLevel<2, -140, LevelUnit::dBm>;
    /// Transmit powers. The field of "Max UE Tx Power" has 6 bits and so never holds 64: kept on purpose.
    static constexpr Formatter TxPower = optionalLevel<64, 1, -30, LevelUnit::dBm>;
    /// Search thresholds: steps of 2 dB. That one of them is shown in dBm is kept on purpose.
    static constexpr Formatter IntraSearch = optionalLevel<32, 2, 0, LevelUnit::dB>;
    static constexpr Formatter NonIntraSearch = optionalLevel<32, 2, 0, LevelUnit::dBm>;
    static constexpr std::array<std::string_view, 2> FalseTrue {{"False", "True"}};

    /// Offsets are those of the byte that holds a field's first bit.
    static constexpr std::array<Field, 18> Fields {{
        {13, Width::U8, "Version", decimal},
        {17, Width::U16, "E-ARFCN", decimal},
        {19, bits(0, 9), "Physical Cell ID", decimal},
        {20, bits(1, 4), "Serving Layer Priority", decimal},
        {21, bits(0, 9), "Measured RSRP", RSRP},
        {22, bits(1, 9), "Average RSRP", RSRP},
        {23, bits(2, 7), "Measured RSRQ", RSRQ},
        {24, bits(1, 7), "Average RSRQ", RSRQ},
        {25, bits(0, 9), "Measured RSSI", RSSI},
        {26, bits(1, 6), "Qrxlevmin", Qrxlevmin},
        {26, bits(7, 7), "P_Max", TxPower},
        {27, bits(6, 6), "Max UE Tx Power", TxPower},
        {29, bits(0, 7), "Srxlev", Srxlev},
        {29, bits(7, 6), "Num of Consecutive DRX Cycles of S < 0", decimal},
        {30, bits(5, 6), "S Intra Search", IntraSearch},
        {31, bits(3, 6), "S Non Intra Search", NonIntraSearch},
        {32, bits(1, 1), "Measurement Rules Updated", flagged<FalseTrue>},
        {32, bits(2, 4), "Measurement Rules", decimal},
    }};
    static constexpr std::array<RecordLayout, 1> Layouts {{
        {.code = 0xB17F, .minimumLength = 33, .fields = Fields},
    }};

public:
    using SectionOf::SectionOf;
    static constexpr SectionDescription Description {.name = "Serving Cell Measurements", .layouts = Layouts};
};

} // namespace spectrel
