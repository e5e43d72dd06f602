#include "Sections/GSMUMTS/GSM/GSMRRInfo.h"

#include "LogGenerator/Template/Fields.h"
#include "Platform/SystemLog.h"

#include <array>

namespace spectrel {

namespace {

constexpr std::uint32_t StateCode = 0x512C;
constexpr std::uint32_t MeasurementCode = 0x5137;
constexpr std::uint32_t DTXCode = 0x5072;
constexpr std::uint32_t DRXCode = 0x51F6;

/// Indexed by their code. The blanks inside three of them are shown.
constexpr std::array<std::string_view, 22> RRStates {{
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

constexpr std::array<std::string_view, 2> Modes {{"Voice", "Data"}};
constexpr std::array<std::string_view, 2> OffOn {{"OFF", "ON"}};

std::string_view seconds(std::uint32_t value, TextBuffer& buffer)
{
    return buffer.decimal(value).text(" sec").view();
}

/// Radio-resource state, code 0x512C, in writing order.
constexpr std::array<Field, 4> StateFields {{
    {13, Width::U8, "RR State", named<RRStates>},
    {14, Width::U8, "RR Sub State", decimal},
    {15, Width::U8, "RR Status", decimal},
    {16, Width::U8, "RR Mode", flagged<Modes>},
}};

/// Measurement, code 0x5137, in writing order.
constexpr std::array<Field, 3> MeasurementFields {{
    {15, Width::U8, "Serving Rx Level", decimal},
    {16, Width::U32, "Rx Quality Full", decimal},
    {20, Width::U32, "Rx Quality Sub", decimal},
}};

/// Discontinuous transmission, code 0x5072.
constexpr std::array<Field, 1> DTXFields {{
    {19, Width::U8, "DTX Used", flagged<OffOn>},
}};

/// Discontinuous reception, code 0x51F6.
constexpr std::array<Field, 1> DRXFields {{
    {16, Width::U8, "DRX Used", seconds},
}};

constexpr std::array<RecordLayout, 4> Layouts {{
    {StateCode, 17, StateFields},
    {MeasurementCode, 29, MeasurementFields},
    {DTXCode, 20, DTXFields},
    {DRXCode, 24, DRXFields},
}};

} // namespace

GSMRRInfo::GSMRRInfo(ClassDictionary& dict, CodeDictionary& codeDict)
{
    enterInto(dict, codeDict);
}

std::string_view GSMRRInfo::getSectionName() const
{
    return "GSM RR Info";
}

std::vector<std::uint32_t> GSMRRInfo::getLogCodeArray() const
{
    return {StateCode, MeasurementCode, DTXCode, DRXCode};
}

void GSMRRInfo::updateWithData(RecordView record, std::uint32_t logCode)
{
    SPECTREL_LOG(Priority::Warning, "GSMRRInfo");
    if (!storeRecord(record, logCode, Layouts, sectionRef))
        logUnknownMessage(logCode);
}

} // namespace spectrel
