#include "Sections/GSMUMTS/Mobility/ServingPLMN.h"

#include "Tests/Sections/CellInformation.h"
#include "Tests/Sections/SectionFixture.h"

namespace spectrel {
namespace {

class ServingPLMNTest : public SectionFixture<ServingPLMN> {
protected:
    ServingPLMNTest()
        : SectionFixture(Dictionary::make())
    {
    }

    static RecordBuilder servingPLMN(std::size_t size = 32)
    {
        return RecordBuilder(0x7135, size)
            .u8(14, 3)
            .u8(15, 0x13)
            .u8(16, 0xF0)
            .u8(17, 0x10)
            .u8(18, 0x12)
            .u8(19, 0x34)
            .u8(20, 200);
    }
    static DictionaryRef servingCell(std::string_view technology)
    {
        return informationOfCell(technology, kRKCellMonitorCellTypeServing,
            {{kRKCellMonitorMCC, 262}, {kRKCellMonitorMNC, 1}, {kRKCellMonitorLAC, 4661}});
    }
};

constexpr const char* Trace = "<4>Serving PLMN\n";
constexpr const char* FromCellInformation =
    "{\"Mobile Country Code\": \"262\", \"Mobile Network Code\": \"1\", \"Location Area Code\": \"4661\"}";

TEST_F(ServingPLMNTest, SubscribesToItsThreeCodes)
{
    EXPECT_EQ(section.getSectionName(), "Serving PLMN");
    EXPECT_EQ(section.getLogCodeArray(), (std::vector<std::uint32_t> {0x7135, 0x7132, 0xFF0001}));
}

TEST_F(ServingPLMNTest, KeysAreWrittenInOrder)
{
    deliver(0x7135, servingPLMN());
    EXPECT_EQ(display(),
        "{\"Mobile Country Code\": \"310\", \"Mobile Network Code\": \"01 \", \"Location Area Code\": \"4660\", "
        "\"Routing Area Code\": \"200\", \"Service Type\": \"CS_PS_SERVICE\"}");
    EXPECT_EQ(log(), Trace);
}

TEST_F(ServingPLMNTest, TwoDigitNetworkCodeEndsInABlank)
{
    deliver(0x7135, servingPLMN().u8(15, 0x13).u8(16, 0xF0).u8(17, 0x10));
    EXPECT_EQ(shown("Mobile Country Code"), "\"310\"");
    EXPECT_EQ(shown("Mobile Network Code"), "\"01 \"");
}

TEST_F(ServingPLMNTest, ThreeDigitNetworkCodeTakesItsThirdFromTheCountrysByte)
{
    deliver(0x7135, servingPLMN().u8(15, 0x13).u8(16, 0x60).u8(17, 0x54));
    EXPECT_EQ(shown("Mobile Country Code"), "\"310\"");
    EXPECT_EQ(shown("Mobile Network Code"), "\"456\"");
}

TEST_F(ServingPLMNTest, NibblesThatAreNoDigitsAreBlanks)
{
    deliver(0x7135, servingPLMN().u8(15, 0xA9).u8(16, 0xFB).u8(17, 0x9C));
    EXPECT_EQ(shown("Mobile Country Code"), "\"9  \"");
    EXPECT_EQ(shown("Mobile Network Code"), "\" 9 \"");
}

TEST_F(ServingPLMNTest, LocationAreaCodeIsBigEndian)
{
    deliver(0x7135, servingPLMN().u8(18, 0x12).u8(19, 0x34));
    EXPECT_EQ(shown("Location Area Code"), "\"4660\"");
    deliver(0x7135, servingPLMN().u8(18, 0xFF).u8(19, 0xFE));
    EXPECT_EQ(shown("Location Area Code"), "\"65534\"");
}

TEST_F(ServingPLMNTest, EveryServiceTypeHasItsName)
{
    EXPECT_EQ(shownForEachByte(0x7135, servingPLMN(), 14, "Service Type"),
        textsForEachByte({"NO_SERVICE", "CS_ONLY", "PS_ONLY", "CS_PS_SERVICE", "LIMITED_SERVICE"}, "Unknown"));
}

TEST_F(ServingPLMNTest, ServiceTypeFiveIsUnknownAndARecordOf31BytesChangesNothing)
{
    deliver(0x7135, servingPLMN(31));
    EXPECT_EQ(display(), "{}");
    EXPECT_EQ(log(), Trace);
    deliver(0x7135, servingPLMN().u8(14, 5));
    EXPECT_EQ(shown("Service Type"), "\"Unknown\"");
}

TEST_F(ServingPLMNTest, SelectionModeOfARegistrationRecordIsShown)
{
    deliver(0x7132, RecordBuilder(0x7132, 15).u8(14, 1));
    EXPECT_EQ(display(), "{}");
    deliver(0x7132, RecordBuilder(0x7132, 16).u8(13, 6).u8(14, 1));
    EXPECT_EQ(display(), "{\"PLMN Sel Mod\": \"Manual\"}");
    EXPECT_EQ(log(), std::string(Trace) + Trace);
}

TEST_F(ServingPLMNTest, EverySelectionModeHasItsName)
{
    EXPECT_EQ(shownForEachByte(0x7132, RecordBuilder(0x7132, 16), 14, "PLMN Sel Mod"),
        textsForEachByte({"Automatic", "Manual", "Limited", "LIMITED_ROUTINE_ACQ", "LIMITED_MANUAL_ACQ"}, "Unknown"));
}

TEST_F(ServingPLMNTest, ServingCellOfUMTSAndOfGSMIsShown)
{
    for (const auto technology : {kRKCellMonitorRadioAccessTechnologyUMTS, kRKCellMonitorRadioAccessTechnologyGSM}) {
        const Value node(Dictionary::make());
        section.updateSectionRef(node);
        log();
        deliverPropertyList(0xFF0001, List::make({servingCell(technology)}));
        EXPECT_EQ(displayText(node), FromCellInformation) << technology;
        EXPECT_EQ(log(), Trace);
    }
}

TEST_F(ServingPLMNTest, ServingCellOfAnotherTechnologyChangesNothing)
{
    deliverPropertyList(0xFF0001, List::make({servingCell(kRKCellMonitorRadioAccessTechnologyLTE)}));
    EXPECT_EQ(display(), "{}");
    EXPECT_EQ(log(), Trace);
}

TEST_F(ServingPLMNTest, FirstServingCellOfEitherTechnologyCounts)
{
    auto neighbour = servingCell(kRKCellMonitorRadioAccessTechnologyUMTS);
    neighbour->set(kRKCellMonitorCellType, kRKCellMonitorCellTypeNeighbor);
    neighbour->set(kRKCellMonitorMCC, Value::integer(1));
    auto second = servingCell(kRKCellMonitorRadioAccessTechnologyUMTS);
    second->set(kRKCellMonitorMCC, Value::integer(2));
    deliverPropertyList(0xFF0001, List::make({neighbour, servingCell(kRKCellMonitorRadioAccessTechnologyGSM), second}));
    EXPECT_EQ(display(), FromCellInformation);
}

TEST_F(ServingPLMNTest, MissingMNCIsLoggedAndTheOthersAreSet)
{
    auto cell = servingCell(kRKCellMonitorRadioAccessTechnologyUMTS);
    cell->remove(kRKCellMonitorMNC);
    deliverPropertyList(0xFF0001, List::make({cell}));
    EXPECT_EQ(display(), "{\"Mobile Country Code\": \"262\", \"Location Area Code\": \"4661\"}");
    EXPECT_EQ(log(), std::string(Trace) + "<3>ServingPLMN: Failed to retrieve MNC\n\n");
}

TEST_F(ServingPLMNTest, EachMissingNumberHasItsOwnLineAndLeavesItsKey)
{
    deliver(0x7135, servingPLMN());
    log();
    deliverPropertyList(0xFF0001,
        List::make({informationOfCell(kRKCellMonitorRadioAccessTechnologyUMTS, kRKCellMonitorCellTypeServing, {})}));
    EXPECT_EQ(shown("Mobile Network Code"), "\"01 \"");
    EXPECT_EQ(log(),
        std::string(Trace)
            + "<3>ServingPLMN: Failed to retrieve MCC\n\n<3>ServingPLMN: Failed to retrieve MNC\n\n"
              "<3>ServingPLMN: Failed to retrieve LAC\n\n");
}

TEST_F(ServingPLMNTest, CellInformationOverwritesTheDigitsAndTheOtherWayRound)
{
    deliver(0x7135, servingPLMN());
    deliverPropertyList(0xFF0001, List::make({servingCell(kRKCellMonitorRadioAccessTechnologyUMTS)}));
    EXPECT_EQ(shown("Mobile Network Code"), "\"1\"");
    EXPECT_EQ(shown("Routing Area Code"), "\"200\"");
    deliver(0x7135, servingPLMN());
    EXPECT_EQ(shown("Mobile Network Code"), "\"01 \"");
}

TEST_F(ServingPLMNTest, PayloadThatDoesNotParseIsLoggedTwice)
{
    deliver(0xFF0001, RecordBuilder(0xFF0001, 20));
    EXPECT_EQ(display(), "{}");
    EXPECT_EQ(log(),
        std::string(Trace) + "<3>Cell Info Array data could not be constructed\n<3>Failed to get Cell Array\n\n");
}

TEST_F(ServingPLMNTest, NoCellsChangeNothing)
{
    deliverPropertyList(0xFF0001, List::make());
    deliverPropertyList(0xFF0001, servingCell(kRKCellMonitorRadioAccessTechnologyUMTS));
    EXPECT_EQ(display(), "{}");
    EXPECT_EQ(log(), std::string(Trace) + Trace);
}

TEST_F(ServingPLMNTest, OtherCodeIsLoggedAsUnknown)
{
    deliver(0x7130, RecordBuilder(0x7130, 40));
    EXPECT_EQ(display(), "{}");
    EXPECT_EQ(log(), std::string(Trace) + "<3>Received an unknown log message: 28976\n");
}

} // namespace
} // namespace spectrel
