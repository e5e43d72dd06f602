#include "Sections/UTRAN/UTRANClassIndex.h"

#include "Tests/Fakes/LogRecorder.h"

#include <gtest/gtest.h>

namespace spectrel {
namespace {

TEST(UTRANClassIndexTest, CodesAreRegisteredInCreationOrder)
{
    const UTRANClassIndex index;
    EXPECT_EQ(index.getAllLogCodes(),
        (std::vector<std::string> {"53472", "53474", "16711681", "53258", "53262", "53260", "16711682", "16711680"}));
}

TEST(UTRANClassIndexTest, EverySectionIsFoundUnderItsName)
{
    const UTRANClassIndex index;
    for (const char* name : {"RRC Info", "Serving Cell Info", "Neighbor Cell List", "GSM Neighbor Cell List",
             "TRCH BLER", "CCTRCH SIR", "PDP Context Info", "SIM Info"}) {
        ASSERT_NE(index.getClass(name), nullptr) << name;
        EXPECT_EQ(index.getClass(name)->getSectionName(), name);
    }
}

TEST(UTRANClassIndexTest, TransportChannelsComeBeforeTheCodedCompositeOnes)
{
    const UTRANClassIndex index;
    const Subscribers* const sections = index.getSubscribers(0xD00C);
    ASSERT_TRUE(sections);
    ASSERT_EQ(sections->size(), 2u);
    EXPECT_EQ((*sections)[0]->getSectionName(), "TRCH BLER");
    EXPECT_EQ((*sections)[1]->getSectionName(), "CCTRCH SIR");
}

TEST(UTRANClassIndexTest, RecordTooShortForEitherIsTracedByBothInOrder)
{
    LogRecorder log;
    const UTRANClassIndex index(log.context());
    log.takeLog();
    const Bytes record(16, 0xFF);
    for (Base* section : *index.getSubscribers(0xD00C))
        section->updateWithData(ByteView(record), 0xD00C);
    EXPECT_EQ(log.takeLog(), "<5>TRCH BLER Measurement\n<4>CCTRCH SIR Measurement\n");
}

TEST(UTRANClassIndexTest, ReleasingItPrintsOnlyTheCommonLine)
{
    LogRecorder log;
    {
        const UTRANClassIndex index(log.context());
    }
    EXPECT_EQ(log.takeConsole(), "Deallocing ClassIndex\n");
}

} // namespace
} // namespace spectrel
