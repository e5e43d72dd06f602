#include "Records/TelephonyConstants.h"
#include "Telephony/Reports/UTRANReports.h"
#include "Tests/Telephony/Simulator/BasebandFixture.h"
#include "Values/Dictionary.h"
#include "Values/List.h"

#include <cstdio>
#include <set>

namespace spectrel {
namespace {

using namespace std::chrono_literals;

constexpr std::uint32_t RadioResourceControl = 0xD0E0;
constexpr std::uint32_t TransportChannels = 0xD00C;
constexpr std::uint32_t SIMFiles = 0xFF0000;
constexpr std::uint32_t CellInformation = 0xFF0001;

class UTRANBasebandTest : public BasebandFixture {
protected:
    UTRANBasebandTest()
        : BasebandFixture(Technology::UTRAN)
    {
    }
    bool isOnDedicatedChannel() const
    {
        return last(RadioResourceControl)[14] == static_cast<std::uint8_t>(RRCMode::CellDCH);
    }
    /// Both counts of the last record of the transport channels.
    bool hasTransportChannels() const
    {
        return last(TransportChannels)[14] != 0 || last(TransportChannels)[15] != 0;
    }
    std::int32_t locationArea() const
    {
        const Value cells = propertyList(last(CellInformation));
        return (*(*cells.list())[0].dictionary())[kRKCellMonitorLAC].int32().value_or(-1);
    }
    std::string simFile(std::string_view key) const
    {
        const Value files = propertyList(last(SIMFiles));
        return *(*files.dictionary())[key].string();
    }
};

TEST_F(UTRANBasebandTest, EveryCodeOfTheCatalogueComesAndNoOther)
{
    drive(5min);
    for (const std::uint32_t code : {0xD00A, 0xD00C, 0xD00E, 0xD0E0, 0xD0E2, 0xFF0000, 0xFF0001, 0xFF0002})
        EXPECT_GT(count(code), 0u) << std::hex << code;
    EXPECT_EQ(records.size(), 8u);
}

TEST_F(UTRANBasebandTest, TransportChannelsGoWithTheDedicatedChannel)
{
    int released = 0;
    int dedicated = 0;
    for (int look = 0; look < 300; ++look) {
        drive(2s); // ends at a record of either kind
        (isOnDedicatedChannel() ? dedicated : released) += 1;
        EXPECT_EQ(hasTransportChannels(), isOnDedicatedChannel()) << look;
    }
    EXPECT_GT(released, 20);
    EXPECT_GT(dedicated, 20);
}

TEST_F(UTRANBasebandTest, SIMHoldsTheLocationAreaOfTheServingCell)
{
    std::set<std::int32_t> areas;
    for (int look = 0; look < 40; ++look) {
        drive(30s); // ends at a record of either kind
        const std::int32_t area = locationArea();
        areas.insert(area);
        char location[32];
        std::snprintf(location, sizeof location, "00F110 %04X ", static_cast<unsigned>(area));
        EXPECT_EQ(simFile("kSimFile_LOCI").find(location), 0u) << simFile("kSimFile_LOCI");
        EXPECT_EQ(simFile("kSimFile_PSLOCI").find(location), 0u) << simFile("kSimFile_PSLOCI");
    }
    EXPECT_EQ(areas.size(), 2u);
    EXPECT_EQ(simFile("kSimFile_RATMODE"), "UTRAN preferred");
}

TEST_F(UTRANBasebandTest, ContextHasATrafficClassInsteadOfLTEsQCI)
{
    drive(2s);
    const Value contexts = propertyList(last(0xFF0002));
    ASSERT_EQ(contexts.list()->count(), 1u);
    const Dictionary& context = *(*contexts.list())[0].dictionary();
    EXPECT_EQ(context["Traffic Class"], Value("Interactive"));
    EXPECT_FALSE(context.contains("QCI"));
}

} // namespace
} // namespace spectrel
