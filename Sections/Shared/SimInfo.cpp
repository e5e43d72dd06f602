#include "Sections/Shared/SimInfo.h"

#include "LogGenerator/Template/PropertyListReaders.h"
#include "Platform/SystemLog.h"

#include <array>

namespace spectrel {

namespace {

struct SimFile {
    std::string_view payloadKey;
    std::string_view displayKey;
};

constexpr std::array<SimFile, 14> SimFiles {{
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

} // namespace

SimInfo::SimInfo(ClassDictionary& dict, CodeDictionary& codeDict)
{
    enterInto(dict, codeDict);
}

std::string_view SimInfo::getSectionName() const
{
    return "SIM Info";
}

std::vector<std::uint32_t> SimInfo::getLogCodeArray() const
{
    return {LogCode_0xFF0000::Code};
}

void SimInfo::updateWithData(RecordView record, std::uint32_t logCode)
{
    SPECTREL_LOG(Priority::Warning, "SimInfo");
    if (logCode != LogCode_0xFF0000::Code)
        return;
    const LogCode_0xFF0000 files(record);
    for (const SimFile& file : SimFiles) {
        if (const Value& content = files[file.payloadKey]; !content.isAbsent())
            store(file.displayKey, content);
    }
}

} // namespace spectrel
