#include "Tests/Telephony/Simulator/BasebandFixture.h"
#include "Values/Dictionary.h"
#include "Values/List.h"

#include <array>
#include <set>

namespace spectrel {
namespace {

using namespace std::chrono_literals;

constexpr std::array<std::uint32_t, 28> Catalogue {0x4005, 0x4031, 0x4116, 0x4125, 0x4127, 0x4157, 0x417A, 0x4221,
    0x5072, 0x5076, 0x512C, 0x5134, 0x5137, 0x51F4, 0x51F5, 0x51F6, 0x51F8, 0x51FB, 0x51FD, 0x51FF, 0x7130, 0x7131,
    0x7132, 0x7135, 0x7150, 0xFF0000, 0xFF0001, 0xFF0002};

class GSMUMTSBasebandTest : public BasebandFixture {
protected:
    GSMUMTSBasebandTest()
        : BasebandFixture(Technology::GSM)
    {
    }
};

TEST_F(GSMUMTSBasebandTest, ItIsTheOneOfItsTechnology)
{
    EXPECT_EQ(makeBaseband(Technology::GSM, Scene::Drive, 1)->technology(), Technology::GSM);
}

TEST_F(GSMUMTSBasebandTest, SameSeedGivesTheSameBytes)
{
    drive(1min);
    const auto first = records;
    start(Scene::Drive, 1);
    drive(1min);
    EXPECT_EQ(first, records);
    start(Scene::Drive, 2);
    drive(1min);
    EXPECT_NE(first, records);
}

TEST_F(GSMUMTSBasebandTest, EveryCodeComesWithinAFewLaps)
{
    drive(20min);
    for (const std::uint32_t code : Catalogue)
        EXPECT_GT(count(code), 0u) << std::hex << code;
    EXPECT_EQ(records.size(), Catalogue.size());
}

TEST_F(GSMUMTSBasebandTest, RatesAreNatural)
{
    drive(10min);
    const std::size_t measured = count(0x417A) + count(0x4005) + count(0x5137);
    EXPECT_GT(measured, 600u) << "the phone listens more than once a second";
    EXPECT_LT(measured, 3000u);
    EXPECT_LT(count(0xFF0000), 60u) << "twice a minute and with every registered area";
    EXPECT_LT(count(0xFF0001), 200u) << "every five seconds and with every new cell";
}

TEST_F(GSMUMTSBasebandTest, NewChannelHearsTheSlowRecordsAtOnce)
{
    drive(10s);
    records.clear();
    greet();
    for (const std::uint32_t code : {0x7130, 0x7131, 0x7132, 0x7135, 0x7150, 0xFF0000, 0xFF0001, 0xFF0002})
        EXPECT_EQ(count(code), 1u) << std::hex << code;
}

TEST_F(GSMUMTSBasebandTest, SystemThatIsLeftFallsSilent)
{
    std::set<bool> systems;
    bool wasOnGSM = false;
    for (int second = 0; second < 1200; ++second) {
        records.clear();
        drive(1s);
        const bool onGSM = count(0x5137) == 2;
        const bool onUMTS = count(0x4005) > 0 && count(0x5137) == 0;
        if (onGSM && wasOnGSM) {
            EXPECT_EQ(count(0x4127) + count(0x4221), 0u) << "in second " << second;
        }
        if (onUMTS) {
            EXPECT_EQ(count(0x5134) + count(0x51FF) + count(0x51F5) + count(0x51FD), 0u) << "in second " << second;
        }
        systems.insert(onGSM);
        wasOnGSM = onGSM;
        if (HasFailure())
            return;
    }
    EXPECT_EQ(systems.size(), 2u);
}

TEST_F(GSMUMTSBasebandTest, LeavingUMTSEmptiesItsCellSets)
{
    drive(20min);
    std::size_t emptied = 0;
    for (const Bytes& record : records.at(0x417A))
        emptied += record[15] == 0;
    EXPECT_GT(emptied, 0u);
}

TEST_F(GSMUMTSBasebandTest, CellInformationNamesTheServingCellFirstAndItsSystem)
{
    drive(20min);
    std::set<std::string> technologies;
    for (const Bytes& record : records.at(0xFF0001)) {
        const Value cells = propertyList(record);
        ASSERT_TRUE(cells.list());
        if (cells.list()->count() == 0)
            continue; // while it searches
        const auto& serving = *(*cells.list())[0].dictionary();
        EXPECT_EQ(serving["kRKCellMonitorCellType"], Value("kRKCellMonitorCellTypeServing"));
        EXPECT_EQ(serving["kRKCellMonitorMCC"].int32(), 1);
        EXPECT_EQ(serving["kRKCellMonitorMNC"].int32(), 1);
        technologies.insert(*serving["kRKCellMonitorCellRadioAccessTechnology"].string());
        for (std::size_t cell = 1; cell < cells.list()->count(); ++cell)
            EXPECT_EQ((*(*cells.list())[cell].dictionary())["kRKCellMonitorCellType"],
                Value("kRKCellMonitorCellTypeNeighbor"));
    }
    EXPECT_EQ(technologies,
        (std::set<std::string> {"kRKCellMonitorRadioAccessTechnologyGSM", "kRKCellMonitorRadioAccessTechnologyUMTS"}));
}

TEST_F(GSMUMTSBasebandTest, CardKnowsTheAreasThatThePhoneIsRegisteredIn)
{
    drive(100ms);
    greet();
    const auto before = propertyList(records.at(0xFF0000).back());
    EXPECT_EQ((*before.dictionary())["kSimFile_LOCI"], Value("00F110 FFFE FE"));
    EXPECT_EQ((*before.dictionary())["kSimFile_PNN"], Value("Test Network"));
    drive(20min);
    std::set<std::string> areas;
    for (const Bytes& record : records.at(0xFF0000)) {
        const auto files = propertyList(record);
        areas.insert((*files.dictionary())["kSimFile_PSLOCI"].string()->substr(7));
    }
    EXPECT_TRUE(areas.contains("04B1 01"));
    EXPECT_TRUE(areas.contains("04B2 02"));
    EXPECT_TRUE(areas.contains("04BB 0B"));
}

TEST_F(GSMUMTSBasebandTest, UpdateIsAnsweredWithTheEquivalentNetworks)
{
    start(Scene::Drive, 28);
    drive(20s);
    ASSERT_GE(count(0x7150), 1u);
    EXPECT_GT(records.at(0x7150).back()[16], 0) << "none before the first update, some after it";
}

TEST_F(GSMUMTSBasebandTest, ContextsAreThereOnlyDuringASession)
{
    drive(20min);
    std::set<std::size_t> counts;
    for (const Bytes& record : records.at(0xFF0002))
        counts.insert(propertyList(record).list()->count());
    EXPECT_EQ(counts, (std::set<std::size_t> {0, 1}));
}

} // namespace
} // namespace spectrel
