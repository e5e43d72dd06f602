#pragma once

#include "LogGenerator/Template/RecordSection.h"

#include <array>

namespace spectrel {

/// The SIM elementary files that the telephony service reports. Shared by every technology.
class SimInfo final : public SectionOf<SimInfo> {
    struct SimFile {
        std::string_view payloadKey;
        std::string_view displayKey;
    };
    static constexpr std::array<SimFile, 14> SimFiles {{
        {"kSimFile_ICCID", "EF-ICCID"},
        {"kSimFile_MSISDN", "EF-MSISDN"},
        {"kSimFile_MBDN", "EF-3GPP MAIL BOX DIALING NUMBER"},
        {"kSimFile_HPPLMN", "EF-HPPLMN SEARCH PERIOD"},
        {"kSimFile_LOCI", "EF-LOCI"},
        {"kSimFile_PSLOCI", "EF-GPRS/PS-LOCI"},
        {"kSimFile_ACC", "EF-ACCESS CONTROL CLASS"},
        {"kSimFile_AD", "EF-ADMINISTRATIVE DATA"},
        {"kSimFile_FPLMN", "EF-FPLMN"},
        {"kSimFile_AHPLMN", "EF-ACTING HPLMN"},
        {"kSimFile_RATMODE", "EF-RAT MODE"},
        {"kSimFile_PNN", "EF-PLMN NETWORK NAME"},
        {"kSimFile_OPL", "EF-OPERATOR PLMN LIST"},
        {"kSimFile_OPLMNAcT", "EF-OPLMNAcT"},
    }};

    /// Stores the files that the payload holds as they are; those it lacks keep their values. A payload that does not
    /// parse raises `LogCode_0xFF0000::UnknownDataException`.
    void storeFiles(RecordView record)
    {
        const LogCode_0xFF0000 files(record, payloads(), log());
        for (const SimFile& file : SimFiles) {
            if (const Value& content = files[file.payloadKey]; !content.isAbsent())
                store(file.displayKey, content);
        }
    }

    static constexpr std::array<RecordLayout, 1> Layouts {{
        {.code = LogCode_0xFF0000::Code, .hook = hook<&SimInfo::storeFiles>},
    }};

public:
    using SectionOf::SectionOf;
    static constexpr SectionDescription Description {
        .name = "SIM Info", .trace = "SimInfo", .layouts = Layouts, .unknownCode = UnknownCode::Ignored};
};

} // namespace spectrel
