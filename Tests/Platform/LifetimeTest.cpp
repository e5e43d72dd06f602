#include "Platform/Lifetime.h"

#include <functional>
#include <gtest/gtest.h>
#include <optional>
#include <string>

namespace spectrel {
namespace {

TEST(LifetimeTest, GuardedActionRunsUntilTheLifetimeEnds)
{
    int runs = 0;
    std::optional<Lifetime> lifetime(std::in_place);
    const std::function<void()> action = lifetime->guard([&runs] { ++runs; });
    action();
    action();
    EXPECT_EQ(runs, 2);
    lifetime.reset();
    action();
    EXPECT_EQ(runs, 2);
}

TEST(LifetimeTest, NewLifetimeDoesNotReviveActionsOfTheOldOne)
{
    int runs = 0;
    std::optional<Lifetime> lifetime(std::in_place);
    const std::function<void()> action = lifetime->guard([&runs] { ++runs; });
    lifetime.emplace();
    action();
    EXPECT_EQ(runs, 0);
}

TEST(LifetimeTest, ArgumentsArePassedOn)
{
    std::string text;
    const Lifetime lifetime;
    const auto action = lifetime.guard([&text](std::string&& word, int count) { text = word + std::to_string(count); });
    action("answer ", 42);
    EXPECT_EQ(text, "answer 42");
}

TEST(LifetimeTest, ActionMayEndTheLifetimeThatGuardsIt)
{
    auto lifetime = std::make_unique<Lifetime>();
    const auto action = lifetime->guard([&lifetime] { lifetime.reset(); });
    action();
    EXPECT_EQ(lifetime, nullptr);
    action();
}

} // namespace
} // namespace spectrel
