#pragma once

#include "LogGenerator/LogGenerator.h"
#include "LogGenerator/Template/ZPHLogGenerator2.h"
#include "Platform/Resources.h"
#include "Tests/Fakes/FakeRunLoop.h"
#include "Tests/Fakes/LogRecorder.h"
#include "Tests/Fakes/RecordBuilder.h"
#include "Tests/Fakes/SourceFolder.h"
#include "Values/Dictionary.h"
#include "Values/List.h"

#include <gtest/gtest.h>
#include <string>

namespace spectrel {

/// A generator with the template that is shipped: what the template lays out, and what a section adds to it.
class TemplateFixture : public testing::Test {
protected:
    /// Builds the display; no record is delivered.
    void build(ZPHLogGenerator2& generator)
    {
        generator.getDisplayFromState(state);
    }
    /// The sections with their keys, in the order of the display: "[Neighbor Cell List]" for a list, else
    /// "RRC Info: State".
    std::string outline() const
    {
        std::string text;
        for (const auto& [name, section] : display().entries()) {
            text += section.list() ? "[" + name + "]" : name + ":";
            if (section.dictionary())
                for (const auto& [key, value] : section.dictionary()->entries())
                    text += " " + key + ",";
            text += "\n";
        }
        return text;
    }
    /// The keys that still hold the template's dash, and the lists that are still empty.
    std::string awaiting() const
    {
        std::string text;
        for (const auto& [name, section] : display().entries()) {
            if (section.list() && section.list()->count() == 0)
                text += name + "\n";
            if (section.dictionary())
                for (const auto& [key, value] : section.dictionary()->entries())
                    if (value == Value("-"))
                        text += name + "/" + key + "\n";
        }
        return text;
    }
    static RecordBuilder everySimFile()
    {
        auto files = Dictionary::make();
        for (const char* name : {"ICCID", "MSISDN", "MBDN", "HPPLMN", "LOCI", "PSLOCI", "ACC", "AD", "FPLMN", "AHPLMN",
                 "RATMODE", "PNN", "OPL", "OPLMNAcT"})
            files->set("kSimFile_" + std::string(name), "there");
        return RecordBuilder::withPropertyList(0xFF0000, files);
    }
    static RecordBuilder oneContext()
    {
        return RecordBuilder::withPropertyList(0xFF0002, List::make({Dictionary::make({{"APN", "internet.test"}})}));
    }

private:
    const Dictionary& display() const
    {
        return *state[StateKey::Display].dictionary();
    }

    FakeRunLoop _time;
    LogRecorder _log;
    const DirectoryResources _shipped {sourcePath("Resources")};

protected:
    Dictionary state;
    const Context context {_time, _shipped, _log, _log};
};

} // namespace spectrel
