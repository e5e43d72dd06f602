#pragma once

#include "Platform/Resources.h"
#include "Sections/GSMUMTS/ZPH_GSMLogGenerator.h"
#include "Telephony/Simulator/GSMUMTS/GSMUMTSWorld.h"
#include "Tests/Fakes/DisplayText.h"
#include "Tests/Fakes/LogRecorder.h"
#include "Tests/Fakes/SourceFolder.h"

#include <cstdlib>
#include <gtest/gtest.h>
#include <string>

namespace spectrel {

/// A simulated phone's records on their way into the display of the shipped template.
class GSMUMTSRoundTrip : public testing::Test {
protected:
    GSMUMTSRoundTrip()
    {
        _generator->getDisplayFromState(_state); // builds it
    }

    void deliver(ByteView record)
    {
        _generator->updateState(_state, record);
    }
    Value display()
    {
        return _generator->getDisplayFromState(_state);
    }
    /// A section's node, wherever the template places it.
    Value section(std::string_view name)
    {
        return find(display(), name);
    }
    std::string shown(std::string_view name, std::string_view key)
    {
        return text(*section(name).dictionary(), key);
    }
    /// A list section, or a list within a section.
    const List& list(std::string_view name)
    {
        return *section(name).list();
    }
    const Dictionary& entry(std::string_view name, std::size_t position)
    {
        return *list(name)[position].dictionary();
    }
    static std::string text(const Dictionary& dictionary, std::string_view key)
    {
        const std::string* string = dictionary[key].string();
        return string ? *string : "none";
    }
    /// The number before the unit.
    static double number(const std::string& shown)
    {
        return std::strtod(shown.c_str(), nullptr);
    }
    static std::string unit(const std::string& shown)
    {
        const auto blank = shown.find(' ');
        return blank == std::string::npos ? "" : shown.substr(blank + 1);
    }

    /// Drives on for some minutes; looks once a second, and at the seams between the systems.
    template <typename Look> static void drive(std::uint32_t seed, int minutes, Look look)
    {
        GSMUMTSWorld world(Scene::Drive, seed);
        for (int step = 0; step < minutes * 600 && !HasFailure(); ++step) {
            world.advance(std::chrono::milliseconds(100));
            if (step % 10 == 0 || world.now().system != world.before().system)
                look(world);
        }
    }

    static constexpr Moment Now {};

    LogRecorder recorder {Priority::Error};

private:
    static Value find(const Value& value, std::string_view name)
    {
        if (!value.dictionary())
            return {};
        for (const auto& [key, inner] : value.dictionary()->entries()) {
            if (key == name)
                return inner;
            if (const Value found = find(inner, name); !found.isAbsent())
                return found;
        }
        return {};
    }

    DirectoryResources _resources {sourcePath("Resources")};
    std::unique_ptr<ZPH_GSMLogGenerator> _generator =
        ZPH_GSMLogGenerator::generator({.resources = _resources, .log = recorder, .console = recorder});
    Dictionary _state;
};

} // namespace spectrel
