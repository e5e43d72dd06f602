#include "Sections/Shared/SimInfo.h"

#include "LogGenerator/Template/PropertyListReaders.h"
#include "Tests/Sections/SectionFixture.h"
#include "Values/List.h"

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
    auto payload = Dictionary::make();
    for (const char* file : {"OPLMNAcT", "OPL", "PNN", "RATMODE", "AHPLMN", "FPLMN", "AD", "ACC", "PSLOCI", "LOCI",
             "HPPLMN", "MBDN", "MSISDN", "ICCID"}) // backwards
        payload->set("kSimFile_" + std::string(file), file);
    deliverPropertyList(0xFF0000, payload);
    EXPECT_EQ(display(),
        "{\"EF-ICCID\": \"ICCID\", \"EF-MSISDN\": \"MSISDN\", \"EF-3GPP MAIL BOX DIALING NUMBER\": \"MBDN\", "
        "\"EF-HPPLMN SEARCH PERIOD\": \"HPPLMN\", \"EF-LOCI\": \"LOCI\", \"EF-GPRS/PS-LOCI\": \"PSLOCI\", "
        "\"EF-ACCESS CONTROL CLASS\": \"ACC\", \"EF-ADMINISTRATIVE DATA\": \"AD\", \"EF-FPLMN\": \"FPLMN\", "
        "\"EF-ACTING HPLMN\": \"AHPLMN\", \"EF-RAT MODE\": \"RATMODE\", \"EF-PLMN NETWORK NAME\": \"PNN\", "
        "\"EF-OPERATOR PLMN LIST\": \"OPL\", \"EF-OPLMNAcT\": \"OPLMNAcT\"}");
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
