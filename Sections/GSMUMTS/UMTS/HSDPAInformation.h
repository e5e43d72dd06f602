#pragma once

#include "LogGenerator/Template/RecordSection.h"

#include <array>

namespace spectrel {

/// High-speed downlink decoding statistics, with one list of HARQ processes for each carrier. A list stays until a
/// record with processes for that carrier replaces it.
class HSDPAInformation final : public SectionOf<HSDPAInformation> {
    static constexpr std::array<std::string_view, 4> CarrierInfos {
        {"Single Carrier", "MIMO", "Dual Carrier", "Reserved"}};

    /// In writing order; the HARQ processes follow.
    static constexpr std::array<Field, 3> Fields {{
        {13, Width::U8, "Version", unsignedDecimal},
        {14, bits(0, 10), "Sub Frames", unsignedDecimal},
        {15, bits(2, 2), "Carrier Info", named<CarrierInfos>},
    }};
    /// A HARQ process, in writing order.
    static constexpr std::array<Field, 4> ProcessFields {{
        {0, Width::U8, "Process ID", unsignedDecimal},
        {1, Width::U32, "No Rx Bits", unsignedDecimal},
        {5, Width::U16, "New Tx", unsignedDecimal},
        {7, Width::U16, "Block Errors", unsignedDecimal},
    }};
    static constexpr std::size_t ProcessSize = 9;
    static constexpr std::size_t PrimaryProcesses = 18;
    /// The secondary carrier's processes stand this far behind for each of the primary's, not directly after them: kept
    /// on purpose.
    static constexpr std::size_t SecondaryDistance = 162;

    void storeProcesses(RecordView record)
    {
        const std::size_t primary = record.u8(16);
        storeCarrier("Primary HARQ Process", record, {PrimaryProcesses, ProcessSize, primary});
        storeCarrier("Secondary HARQ Process", record,
            {PrimaryProcesses + SecondaryDistance * primary, ProcessSize, record.u8(17)});
    }
    void storeCarrier(std::string_view key, RecordView record, const RepeatedGroup& processes)
    {
        if (processes.count > 0)
            store(key, entriesWithFields(record, processes, ProcessFields));
    }

    static constexpr std::array<RecordLayout, 1> Layouts {{
        {.code = 0x4221, .minimumLength = 18, .fields = Fields, .hook = hook<&HSDPAInformation::storeProcesses>},
    }};

public:
    using SectionOf::SectionOf;
    static constexpr SectionDescription Description {
        .name = "HSDPA Info", .layouts = Layouts, .unknownCode = UnknownCode::Ignored};
};

} // namespace spectrel
