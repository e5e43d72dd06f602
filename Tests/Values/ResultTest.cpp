#include "Values/Result.h"

#include <gtest/gtest.h>
#include <memory>

namespace spectrel {
namespace {

struct Base {
    virtual ~Base() = default;
    virtual int number() const = 0;
};
struct Seven final : Base {
    int number() const override
    {
        return 7;
    }
};

Result<std::unique_ptr<Base>> makeSeven(bool isPossible)
{
    if (!isPossible)
        return Failure {"there is no seven", Failure::Code::Missing};
    return std::make_unique<Seven>();
}

TEST(ResultTest, HoldsAValueMadeOfWhatIsReturned)
{
    const auto seven = makeSeven(true);
    ASSERT_TRUE(seven);
    EXPECT_EQ((*seven)->number(), 7);
}

TEST(ResultTest, GivesItsValueAway)
{
    const std::unique_ptr<Base> seven = *makeSeven(true);
    EXPECT_EQ(seven->number(), 7);
    Result<std::string> text = std::string("text");
    EXPECT_EQ(text->size(), 4u);
    *text += "s";
    EXPECT_EQ(*std::move(text), "texts");
}

TEST(ResultTest, HoldsWhyThereIsNoValue)
{
    const auto none = makeSeven(false);
    ASSERT_FALSE(none);
    EXPECT_EQ(none.failure().text, "there is no seven");
    EXPECT_EQ(none.failure().code, Failure::Code::Missing);
}

TEST(ResultTest, NullIsAValueLikeAnother)
{
    const Result<std::unique_ptr<Base>> null = std::unique_ptr<Base>();
    EXPECT_TRUE(null);
}

TEST(ResultTest, OutcomeIsDoneOrFailed)
{
    EXPECT_TRUE(Outcome(Done()));
    EXPECT_FALSE(Outcome(Failure {"no"}));
    EXPECT_EQ(Outcome(Failure {"no"}).failure().code, Failure::Code::Failed);
}

TEST(FailureTest, SystemCallsFailInTheSystemsWordsWithACode)
{
    const struct {
        int error;
        const char* text;
        Failure::Code code;
    } rows[] = {
        {EEXIST, "File exists", Failure::Code::Exists},
        {ENOENT, "No such file or directory", Failure::Code::Missing},
        {EACCES, "Permission denied", Failure::Code::Refused},
        {EISDIR, "Is a directory", Failure::Code::Refused},
        {ENOSPC, "No space left on device", Failure::Code::NoRoom},
        {EMFILE, "Too many open files", Failure::Code::NoRoom},
        {EIO, "Input/output error", Failure::Code::Failed},
    };
    for (const auto& row : rows) {
        errno = row.error;
        const Failure failure = Failure::ofSystem();
        EXPECT_EQ(failure.text, row.text);
        EXPECT_EQ(failure.code, row.code) << row.text;
    }
}

TEST(FailureTest, IsLedInByWhatFailed)
{
    const Failure failure = Failure::ofSystem(ENOENT).of("x.pcap");
    EXPECT_EQ(failure.text, "x.pcap: No such file or directory");
    EXPECT_EQ(failure.code, Failure::Code::Missing);
}

} // namespace
} // namespace spectrel
