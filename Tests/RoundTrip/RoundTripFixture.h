#pragma once

#include "LogGenerator/LogGenerator.h"
#include "Platform/Resources.h"
#include "Records/Recording.h"
#include "Tests/Fakes/FakeRunLoop.h"
#include "Tests/Fakes/SourceFolder.h"
#include "Values/Dictionary.h"
#include "Values/List.h"

#include <cstdlib>
#include <gtest/gtest.h>
#include <string>

namespace spectrel {

/// From a simulated world through its encoders and the generator to the display, with the templates that are shipped.
class RoundTripFixture : public testing::Test {
protected:
    explicit RoundTripFixture(Technology technology)
    {
        _generator = LogGenerator::generatorFromTechnology(
            Value(technologyConstant(technology)), {.clock = _time, .resources = _shipped});
    }

    void deliver(ByteView record)
    {
        _generator->updateState(_state, record);
    }
    /// A section's text under a key.
    std::string text(std::string_view section, std::string_view key) const
    {
        return textOf(*node(section).dictionary(), key);
    }
    /// A section's number under a key, its unit aside.
    double number(std::string_view section, std::string_view key) const
    {
        return numberOf(*node(section).dictionary(), key);
    }
    const List& list(std::string_view section) const
    {
        return *node(section).list();
    }
    static std::string textOf(const Dictionary& dictionary, std::string_view key)
    {
        const std::string* const text = dictionary[key].string();
        return text ? *text : "(none)";
    }
    static double numberOf(const Dictionary& dictionary, std::string_view key)
    {
        return std::strtod(textOf(dictionary, key).c_str(), nullptr);
    }

    static constexpr Moment Time {std::chrono::hours(500000)};

private:
    const Value& node(std::string_view section) const
    {
        return (*_state[StateKey::Display].dictionary())[section];
    }

    FakeRunLoop _time;
    const DirectoryResources _shipped {sourcePath("Resources")};
    std::unique_ptr<LogGenerator> _generator;
    Dictionary _state;
};

} // namespace spectrel
