#include "Tests/Fakes/CountedAllocations.h"
#include "Tests/Platform/PortFixture.h"

namespace spectrel {
namespace {

class AllocationTest : public PortFixture { };

TEST_F(AllocationTest, MessagesInTheSteadyStateAllocateNothing)
{
    constexpr std::size_t Count = 4'000;
    std::size_t arrived = 0;
    const auto local = serve([&](std::int32_t, ByteView) {
        ++arrived;
        return std::nullopt;
    });
    const auto remote = ports.createRemote(Name);
    const auto exchange = [&](std::size_t upTo) {
        for (std::size_t sent = arrived; sent < upTo; sent += 100) {
            for (int i = 0; i < 100; ++i)
                send(*remote, 0, "a message like any other");
            ASSERT_TRUE(turnUntil([&] { return arrived == sent + 100; }));
        }
    };
    exchange(100);
    const std::size_t before = allocationCount();
    exchange(100 + Count);
    EXPECT_LT(allocationCount() - before, Count / 10); // what the turns of the loop take, none for each message
}

} // namespace
} // namespace spectrel
