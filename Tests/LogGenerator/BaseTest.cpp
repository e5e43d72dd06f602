#include "LogGenerator/Template/Base.h"

#include "LogGenerator/Template/ArrayLock.h"
#include "LogGenerator/Template/ArrayOutOfBoundsException.h"
#include "LogGenerator/Template/ClassIndex.h"
#include "Records/RecordView.h"
#include "Tests/Fakes/DisplayText.h"
#include "Tests/Fakes/LogRecorder.h"
#include "Values/Dictionary.h"

#include <gtest/gtest.h>
#include <thread>

namespace spectrel {
namespace {

/// A section that writes down what it is given.
class Scribe final : public Base {
public:
    Scribe(const Context& context, ClassDictionary& dict, CodeDictionary& codeDict, std::string name,
        std::vector<std::uint32_t> codes, std::string& diary)
        : Base(context)
        , _name(std::move(name))
        , _codes(std::move(codes))
        , _diary(diary)
    {
        enterInto(dict, codeDict);
    }
    std::string_view getSectionName() const override
    {
        return _name;
    }
    std::vector<std::uint32_t> getLogCodeArray() const override
    {
        return _codes;
    }
    void updateWithData(RecordView, std::uint32_t logCode) override
    {
        _diary += _name + " " + std::to_string(logCode) + "\n";
        storeText("Code", std::to_string(logCode));
        removeKey("Gone");
    }

private:
    std::string _name;
    std::vector<std::uint32_t> _codes;
    std::string& _diary;
};

class ScribeIndex final : public ClassIndex {
public:
    ScribeIndex(const Context& given, std::string& diary)
        : ClassIndex(given)
        , first(context, classDict, codeDictionary, "First", {20984, 0xFF0C00}, diary)
        , second(context, classDict, codeDictionary, "Second", {20984, 5, 5}, diary)
    {
    }
    Scribe first;
    Scribe second;
};

class SectionObjectsTest : public testing::Test {
protected:
    void deliver(std::uint32_t code)
    {
        if (const Subscribers* subscribers = index.getSubscribers(code)) {
            for (Base* section : *subscribers)
                section->updateWithData(RecordView({}), code);
        }
    }
    LogRecorder log;
    std::string diary;
    ScribeIndex index {log.context(), diary};
};

TEST_F(SectionObjectsTest, SectionsOfOneCodeAreCalledInTheOrderOfTheirCreation)
{
    deliver(20984);
    EXPECT_EQ(diary, "First 20984\nSecond 20984\n");
}

TEST_F(SectionObjectsTest, CodeListedTwiceIsDeliveredTwice)
{
    deliver(5);
    EXPECT_EQ(diary, "Second 5\nSecond 5\n");
}

TEST_F(SectionObjectsTest, CodeThatNobodyRegisteredHasNoSubscribers)
{
    EXPECT_EQ(index.getSubscribers(20985), nullptr);
}

TEST_F(SectionObjectsTest, KeysAreTheCodesDecimalTexts)
{
    EXPECT_EQ(index.getAllLogCodes(), (std::vector<std::string> {"20984", "16714752", "5"}));
}

TEST_F(SectionObjectsTest, IndexWithoutSectionsHasNoCodes)
{
    EXPECT_TRUE(ClassIndex().getAllLogCodes().empty());
}

TEST_F(SectionObjectsTest, RegistrationLogsTheNumberOfCodes)
{
    EXPECT_EQ(log.takeLog(), "<4>Array Count: 2\n<4>Array Count: 3\n");
}

TEST_F(SectionObjectsTest, SectionsAreFoundByName)
{
    EXPECT_EQ(index.getClass("Second"), &index.second);
    EXPECT_EQ(index.getClass("Third"), nullptr);
}

TEST_F(SectionObjectsTest, BindingLogsTheSectionName)
{
    log.takeLog();
    index.first.updateSectionRef(Dictionary::make());
    EXPECT_EQ(log.takeLog(), "<4>First\n");
}

TEST_F(SectionObjectsTest, WritesWithoutANodeAreLost)
{
    deliver(20984);
    auto node = Dictionary::make({{"Gone", "x"}});
    index.first.updateSectionRef(node);
    EXPECT_EQ(displayText(node), "{\"Gone\": \"x\"}");
    deliver(20984);
    EXPECT_EQ(displayText(node), "{\"Code\": \"20984\"}");
    index.first.updateSectionRef("a text is no node either");
    deliver(20984);
}

TEST_F(SectionObjectsTest, StatusAlwaysTellsOneAndZero)
{
    log.takeLog();
    index.status();
    EXPECT_EQ(log.takeLog(), "<4>Dictionary = 1\n<4>String = 0\n");
}

TEST(ClassIndexTest, DestructionWritesOneLineToTheConsole)
{
    LogRecorder log;
    {
        const ClassIndex index(log.context());
    }
    EXPECT_EQ(log.takeConsole(), "Deallocing ClassIndex\n");
}

TEST(LookUpECNOTest, LadderHoldsAtItsEdges)
{
    EXPECT_EQ(Base::lookUpECNO(0xFFFFFFFF), 0);
    EXPECT_EQ(Base::lookUpECNO(524288), 0);
    EXPECT_EQ(Base::lookUpECNO(524287), -1);
    EXPECT_EQ(Base::lookUpECNO(417648), -1);
    EXPECT_EQ(Base::lookUpECNO(417647), -2);
    EXPECT_EQ(Base::lookUpECNO(757), -31);
    EXPECT_EQ(Base::lookUpECNO(756), -31);
    EXPECT_EQ(Base::lookUpECNO(706), -31);
    EXPECT_EQ(Base::lookUpECNO(705), 0);
    EXPECT_EQ(Base::lookUpECNO(0), 0);
}

TEST(LookUpECNOTest, EveryRungIsExceededOneAboveIt)
{
    constexpr std::uint32_t Rungs[] = {417647, 331808, 263624, 209463, 166441, 132268, 105123, 83562, 66435, 52830,
        42023, 33440, 26621, 21205, 16903, 13486, 10771, 8615, 6902, 5542, 4461, 3603, 2921, 2240, 1949, 1607, 1336,
        1120, 949, 813, 756};
    int decibels = -1;
    for (const std::uint32_t rung : Rungs)
        EXPECT_EQ(Base::lookUpECNO(rung + 1), decibels--) << rung;
}

TEST(ArrayOperationsTest, ReplacingAndClearingKeepTheListItself)
{
    const auto shown = List::make({"a", "b"});
    const auto fresh = List::make({"c"});
    Base::replaceArray(*shown, *fresh);
    EXPECT_EQ(displayText(shown), "[\"c\"]");
    Base::clearElementsInArray(*shown);
    EXPECT_EQ(displayText(shown), "[]");
    EXPECT_EQ(displayText(fresh), "[\"c\"]");
}

bool isFreeForOthers()
{
    bool isFree = false;
    std::thread([&] {
        isFree = ArrayLock::mutex().try_lock();
        if (isFree)
            ArrayLock::mutex().unlock();
    }).join();
    return isFree;
}

TEST(ArrayLockTest, OnePairLeavesTheLockFreeAndANestedPairLeavesItHeldOnce)
{
    ArrayLock::lockArray();
    EXPECT_FALSE(isFreeForOthers());
    ArrayLock::unlockArray();
    EXPECT_TRUE(isFreeForOthers());

    ArrayLock::lockArray();
    ArrayLock::lockArray();
    ArrayLock::unlockArray();
    ArrayLock::unlockArray();
    EXPECT_FALSE(isFreeForOthers());
    ArrayLock::mutex().unlock(); // once is enough
    EXPECT_TRUE(isFreeForOthers());
}

TEST(ArrayOutOfBoundsExceptionTest, SaysWhatTheStandardLibrarySays)
{
    EXPECT_STREQ(ArrayOutOfBoundsException().what(), std::exception().what());
}

} // namespace
} // namespace spectrel
