#pragma once

#include "Analysis/Analysis.h"
#include "LogGenerator/LogGenerator.h"
#include "Tests/Fakes/FakeResources.h"
#include "Tests/Fakes/LogRecorder.h"
#include "Values/Dictionary.h"
#include "Values/List.h"

#include <chrono>
#include <cmath>
#include <cstdio>
#include <functional>
#include <gtest/gtest.h>
#include <initializer_list>
#include <memory>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

namespace spectrel {

/// A generator under another's name, whose messages store what the test says.
class ScriptedGenerator final : public LogGenerator {
public:
    using Script = std::function<void(Dictionary& display)>;

    ScriptedGenerator(const Context& context, std::string_view name, const Script& script)
        : LogGenerator(context)
        , _name(name)
        , _script(script)
    {
    }
    void updateState(Dictionary& state, ByteView) override
    {
        if (state[StateKey::Display].isAbsent())
            state.set(StateKey::Display, Dictionary::make());
        const DictionaryRef display = state[StateKey::Display].dictionary();
        _script(*display);
    }
    Value generateLogUsingState(Dictionary& state) override
    {
        return state[StateKey::Display];
    }
    DictionaryRef getStartCommand() override
    {
        return Dictionary::make();
    }
    ListRef getSaveContentsFromState(const Dictionary&) override
    {
        return List::make();
    }
    std::string_view className() const override
    {
        return _name;
    }

private:
    std::string _name;
    const Script& _script;
};

/// Shows what a cell is told to be: "lte id=52 channel=1300 RSRP=-104.5".
inline std::string toldOf(const Cell& cell)
{
    std::string text(radioTechnologyName(cell.technology));
    const auto add = [&text](std::string_view key, const std::string& value) {
        text += " " + std::string(key) + "=" + value;
    };
    const auto number = [](double value) {
        char digits[64];
        std::snprintf(digits, sizeof digits, "%.10g", value);
        return std::string(digits);
    };
    const auto addNumber = [&](std::string_view key, const auto& value) {
        if (value)
            add(key, number(static_cast<double>(*value)));
    };
    if (!cell.plmn.empty())
        add("plmn", cell.plmn);
    if (!cell.operatorName.empty())
        add("operator", cell.operatorName);
    addNumber("area", cell.area);
    addNumber("cell", cell.cell);
    addNumber("site", cell.site);
    addNumber("rnc", cell.rnc);
    addNumber("sector", cell.sector);
    addNumber("id", cell.id);
    addNumber("channel", cell.channel);
    if (!cell.band.empty())
        add("band", cell.band);
    addNumber("down", cell.downlinkMHz);
    addNumber("up", cell.uplinkMHz);
    addNumber("width", cell.bandwidthMHz);
    for (std::size_t level = 0; level < LevelCount; ++level)
        addNumber(levelName(static_cast<Level>(level)), cell.levels[level]);
    return text;
}

/// A display of one technology, filled message by message.
class AnalysisFixture : public testing::Test {
protected:
    using Leaf = std::pair<std::string_view, std::string_view>; // path and value; no value: removed
    using Fields = std::vector<Dictionary::Entry>;

    explicit AnalysisFixture(std::string_view generator)
    {
        use(generator);
    }
    void use(std::string_view generator)
    {
        display.useTechnology(std::string(generator));
    }

    /// One message that does this to the display.
    void message(const ScriptedGenerator::Script& what)
    {
        script = what;
        const std::uint8_t byte = 0;
        display.apply({&byte, 1}, now);
    }
    /// One message that stores these leaves.
    void show(std::initializer_list<Leaf> leaves)
    {
        message([&](Dictionary& root) {
            for (const auto& [path, value] : leaves)
                store(root, path, value);
        });
    }
    /// Part of a message: stores a leaf, or takes it away when the value is "(gone)".
    static void store(Dictionary& root, std::string_view path, std::string_view value)
    {
        const auto [container, key] = placeOf(root, path);
        if (value == "(gone)")
            container->remove(key);
        else
            container->setText(key, value);
    }
    /// Part of a message: replaces a list of dictionaries.
    static void list(Dictionary& root, std::string_view path, const std::vector<Fields>& entries)
    {
        const auto [container, key] = placeOf(root, path);
        auto elements = List::make();
        for (const Fields& fields : entries) {
            auto entry = Dictionary::make();
            for (const auto& [name, value] : fields)
                entry->set(name, value);
            elements->append(entry);
        }
        container->set(key, elements);
    }
    void showList(std::string_view path, const std::vector<Fields>& entries)
    {
        message([&](Dictionary& root) { list(root, path, entries); });
    }
    void later(std::chrono::milliseconds time)
    {
        now += time;
    }

    std::string serving() const
    {
        return analysis.serving() ? toldOf(*analysis.serving()) : "none";
    }
    std::string active() const
    {
        return joined(analysis.report().active);
    }
    std::string neighbours() const
    {
        return joined(analysis.report().neighbours);
    }
    std::string connection() const
    {
        const auto known = analysis.report().connection;
        return known ? std::string(connectionName(*known)) : "unknown";
    }
    std::string sourceOf(CellKey key) const
    {
        return analysis.serving() ? analysis.pathOf(analysis.serving()->origin(key)) : "";
    }

    Moment now {std::chrono::seconds(1733000000)};
    ScriptedGenerator::Script script;
    LogRecorder log;
    FakeResources resources;
    const Context context {.resources = resources, .log = log, .console = log};
    DisplayState display {[this](const Value& name, const Context& given) {
                              return std::make_unique<ScriptedGenerator>(given, *name.string(), script);
                          },
        context};
    Analysis analysis {display};

private:
    static std::pair<DictionaryRef, std::string> placeOf(Dictionary& root, std::string_view path)
    {
        DictionaryRef container;
        path.remove_prefix(1);
        for (std::size_t slash = path.find('/'); slash != std::string_view::npos; slash = path.find('/')) {
            Dictionary& parent = container ? *container : root;
            const std::string_view name = path.substr(0, slash);
            if (!parent[name].dictionary())
                parent.set(name, Dictionary::make());
            container = parent[name].dictionary();
            path.remove_prefix(slash + 1);
        }
        if (!container)
            container = DictionaryRef(&root, [](Dictionary*) {}); // the root itself, which outlives this
        return {container, std::string(path)};
    }
    template <typename Cells> static std::string joined(const Cells& cells)
    {
        std::string text;
        for (const Cell& cell : cells)
            text += (text.empty() ? "" : "; ") + toldOf(cell);
        return text;
    }
};

} // namespace spectrel
