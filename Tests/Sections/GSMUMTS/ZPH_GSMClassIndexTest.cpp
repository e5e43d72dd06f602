#include "Sections/GSMUMTS/ZPH_GSMClassIndex.h"

#include "Tests/Fakes/LogRecorder.h"
#include "Tests/Fakes/RecordBuilder.h"

#include <gtest/gtest.h>
#include <set>

namespace spectrel {
namespace {

std::vector<std::string> subscribers(const ClassIndex& index, std::uint32_t code)
{
    std::vector<std::string> names;
    for (const Base* section : *index.getSubscribers(code))
        names.emplace_back(section->getSectionName());
    return names;
}

TEST(ZPH_GSMClassIndexTest, EverySectionIsFoundUnderItsName)
{
    const ZPH_GSMClassIndex index;
    const std::set<std::string> names {"Active Set", "Coding Scheme", "GPRS Information", "GSM Serving Cell",
        "Mobile Allocation", "Neighboring Cells", "PDP Context Info", "Process PS", "UMTS RR Measurement",
        "Cell Change Counters", "Detected Set", "GSM Set", "Non-Ranked GSM Set", "Process CO", "Serving PLMN",
        "UMTS Set", "Equivalent PLMN List", "GSM RR Info", "Monitored Set", "Non-Ranked UMTS Set", "Process CS",
        "UMTS RR Info", "BLER", "Virtual Active Set", "SIM Info", "HSDPA Info"};
    EXPECT_EQ(names.size(), 26u);
    for (const std::string& name : names) {
        ASSERT_NE(index.getClass(name), nullptr) << name;
        EXPECT_EQ(index.getClass(name)->getSectionName(), name);
    }
}

TEST(ZPH_GSMClassIndexTest, CodesAreRegisteredInTheOrderOfCreation)
{
    const ZPH_GSMClassIndex index;
    EXPECT_EQ(index.getAllLogCodes(),
        (std::vector<std::string> {"16762", // active set
            "20981", "28981", "20982", "20987", "20989", "20980", "20791", // GPRS
            "20788", "20598", "16711681", // GSM serving cell
            "20984", "20991", "16711682", "28976", "28978", "16389", "28977", "29008", // mobile allocation and on
            "20780", "20594", // GSM RR
            "16677", "16433", "16679", "16727", // UMTS RR
            "16662", "16711680", "16929"}));
}

TEST(ZPH_GSMClassIndexTest, FreshIndexHolds27CodesAndTheOneOfHSDPA)
{
    const ZPH_GSMClassIndex index;
    const auto codes = index.getAllLogCodes();
    const std::set<std::string> different(codes.begin(), codes.end());
    EXPECT_EQ(different.size(), 28u);
    EXPECT_TRUE(different.contains("16929"));
    EXPECT_EQ(index.getSubscribers(16762)->size(), 4u);
    EXPECT_EQ(index.getSubscribers(28978)->size(), 4u);
}

TEST(ZPH_GSMClassIndexTest, EveryCodeIsDeliveredInTheOrderOfCreation)
{
    using Names = std::vector<std::string>;
    const ZPH_GSMClassIndex index;
    EXPECT_EQ(subscribers(index, 0x4005), (Names {"GSM Set", "UMTS Set"}));
    for (const std::uint32_t code : {0x4031u, 0x4125u, 0x4127u, 0x4157u})
        EXPECT_EQ(subscribers(index, code), (Names {"UMTS RR Info"})) << code;
    EXPECT_EQ(subscribers(index, 0x4116), (Names {"BLER"}));
    EXPECT_EQ(
        subscribers(index, 0x417A), (Names {"Active Set", "Detected Set", "Monitored Set", "Virtual Active Set"}));
    for (const std::uint32_t code : {0x5072u, 0x512Cu})
        EXPECT_EQ(subscribers(index, code), (Names {"GSM RR Info"})) << code;
    for (const std::uint32_t code : {0x5076u, 0x5134u})
        EXPECT_EQ(subscribers(index, code), (Names {"GSM Serving Cell"})) << code;
    EXPECT_EQ(subscribers(index, 0x5137),
        (Names {"GPRS Information", "GSM Serving Cell", "Neighboring Cells", "GSM RR Info"}));
    for (const std::uint32_t code : {0x51F4u, 0x51F5u, 0x51FBu, 0x51FDu})
        EXPECT_EQ(subscribers(index, code), (Names {"GPRS Information"})) << code;
    EXPECT_EQ(subscribers(index, 0x51F6), (Names {"GPRS Information", "GSM RR Info"}));
    EXPECT_EQ(subscribers(index, 0x51F8), (Names {"Mobile Allocation"}));
    EXPECT_EQ(subscribers(index, 0x51FF), (Names {"Neighboring Cells"}));
    EXPECT_EQ(subscribers(index, 0x7130), (Names {"Process PS"}));
    EXPECT_EQ(subscribers(index, 0x7131), (Names {"Process CO", "Process CS"}));
    EXPECT_EQ(subscribers(index, 0x7132), (Names {"Process PS", "Process CO", "Serving PLMN", "Process CS"}));
    EXPECT_EQ(subscribers(index, 0x7135), (Names {"GPRS Information", "Serving PLMN"}));
    EXPECT_EQ(subscribers(index, 0x7150), (Names {"Equivalent PLMN List"}));
    EXPECT_EQ(subscribers(index, 0xFF0000), (Names {"SIM Info"}));
    EXPECT_EQ(subscribers(index, 0xFF0001),
        (Names {"GSM Serving Cell", "Neighboring Cells", "Serving PLMN", "UMTS Set", "UMTS RR Info"}));
    EXPECT_EQ(subscribers(index, 0xFF0002), (Names {"PDP Context Info"}));
    EXPECT_EQ(subscribers(index, 0x4221), (Names {"HSDPA Info"}));
}

TEST(ZPH_GSMClassIndexTest, RecordsRunThroughTheirSectionsInThatOrder)
{
    LogRecorder recorder;
    const ZPH_GSMClassIndex index(recorder.context());
    recorder.takeLog();
    for (const std::uint32_t code : {0x7132u, 0x5137u}) {
        for (Base* section : *index.getSubscribers(code))
            section->updateWithData(RecordView(RecordBuilder(code, 60)), code);
    }
    EXPECT_EQ(recorder.takeLog(),
        "<4>ProcessPS\n<4>ProcessCS\n<4>Serving PLMN\n<4>ProcessCS\n"
        "<4>GPRSInformation\n<4>GSMServingCell\n<4>NeighboringCells\n<4>GSMRRInfo\n");
}

TEST(ZPH_GSMClassIndexTest, ReleasingItPrintsItsLineOnce)
{
    LogRecorder recorder;
    {
        const ZPH_GSMClassIndex index(recorder.context());
    }
    EXPECT_EQ(recorder.takeConsole(), "Deallocing ZPH_GSMClassIndex\nDeallocing ClassIndex\n");
}

} // namespace
} // namespace spectrel
