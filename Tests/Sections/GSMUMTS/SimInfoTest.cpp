#include "Sections/GSMUMTS/SimInfo.h"

#include "LogGenerator/Template/PropertyListReaders.h"
#include "Platform/List.h"
#include "Tests/Sections/SectionFixture.h"

namespace spectrel {
namespace {

class SimInfoTest : public SectionFixture<SimInfo> {
protected:
    SimInfoTest()
        : SectionFixture(Dictionary::make())
    {
    }
};

TEST_F(SimInfoTest, OnlyTheICCIDSetsOnlyTheICCID)
{
    deliverPropertyList(0xFF0000, Dictionary::make({{"kSimFile_ICCID", "8900112233"}}));
    EXPECT_EQ(display(), "{\"EF-ICCID\": \"8900112233\"}");
    EXPECT_EQ(log(), "<4>SimInfo\n");
}

TEST_F(SimInfoTest, AbsentFilesKeepTheirValues)
{
    deliverPropertyList(0xFF0000, Dictionary::make({{"kSimFile_ICCID", "1"}, {"kSimFile_LOCI", "2"}}));
    deliverPropertyList(0xFF0000, Dictionary::make({{"kSimFile_LOCI", "3"}}));
    EXPECT_EQ(display(), "{\"EF-ICCID\": \"1\", \"EF-LOCI\": \"3\"}");
}

TEST_F(SimInfoTest, EveryFileHasItsLabelInTableOrder)
{
    const std::pair<const char*, const char*> files[] = {{"kSimFile_OPLMNAcT", "EF-OPLMNAcT"},
        {"kSimFile_ICCID", "EF-ICCID"}, {"kSimFile_MSISDN", "EF-MSISDN"},
        {"kSimFile_MBDN", "EF-3GPP MAIL BOX DIALING NUMBER"}, {"kSimFile_HPPLMN", "EF-HPPLMN SEARCH PERIOD"},
        {"kSimFile_LOCI", "EF-LOCI"}, {"kSimFile_PSLOCI", "EF-GPRS/PS-LOCI"},
        {"kSimFile_ACC", "EF-ACCESS CONTROL CLASS"}, {"kSimFile_AD", "EF-ADMINISTRATIVE DATA"},
        {"kSimFile_FPLMN", "EF-FPLMN"}, {"kSimFile_AHPLMN", "EF-ACTING HPLMN"}, {"kSimFile_RATMODE", "EF-RAT MODE"},
        {"kSimFile_PNN", "EF-PLMN NETWORK NAME"}, {"kSimFile_OPL", "EF-OPERATOR PLMN LIST"}};
    auto payload = Dictionary::make();
    for (const auto& [key, label] : files)
        payload->set(key, label);
    deliverPropertyList(0xFF0000, payload);
    for (const auto& [key, label] : files)
        EXPECT_EQ(shown(label), "\"" + std::string(label) + "\"") << key;
    EXPECT_EQ(display().find("{\"EF-ICCID\""), 0u);
    EXPECT_NE(display().find("\"EF-OPLMNAcT\": \"EF-OPLMNAcT\"}"), std::string::npos);
}

TEST_F(SimInfoTest, ValuesAreStoredAsTheyAre)
{
    deliverPropertyList(
        0xFF0000, Dictionary::make({{"kSimFile_ACC", Value::integer(3)}, {"kSimFile_PNN", List::make({"a"})}}));
    EXPECT_EQ(display(), "{\"EF-ACCESS CONTROL CLASS\": int 3, \"EF-PLMN NETWORK NAME\": [\"a\"]}");
}

TEST_F(SimInfoTest, PayloadThatIsNoPropertyListIsLoggedRaisesAndChangesNothing)
{
    deliverPropertyList(0xFF0000, Dictionary::make({{"kSimFile_ICCID", "1"}}));
    log();
    const Bytes garbage {'<', 'x'};
    EXPECT_THROW(
        deliver(0xFF0000, RecordBuilder::withPayload(0xFF0000, garbage)), LogCode_0xFF0000::UnknownDataException);
    EXPECT_EQ(display(), "{\"EF-ICCID\": \"1\"}");
    EXPECT_EQ(log(), "<4>SimInfo\n<3>SIM File dictionary data could not be constructed\n");
}

TEST_F(SimInfoTest, RecordWithoutPayloadRaises)
{
    EXPECT_THROW(deliver(0xFF0000, RecordBuilder(0xFF0000, 13)), LogCode_0xFF0000::UnknownDataException);
}

TEST_F(SimInfoTest, PayloadThatIsNoDictionaryHasNoFiles)
{
    deliverPropertyList(0xFF0000, List::make({"kSimFile_ICCID"}));
    EXPECT_EQ(display(), "{}");
}

TEST_F(SimInfoTest, OtherCodeIsIgnoredWithoutAMessage)
{
    deliver(0xB0C2, RecordBuilder(0xB0C2, 40));
    EXPECT_EQ(display(), "{}");
    EXPECT_EQ(log(), "<4>SimInfo\n");
}

} // namespace
} // namespace spectrel
