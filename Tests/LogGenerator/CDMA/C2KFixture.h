#pragma once

#include "LogGenerator/CDMA/C2KLogGenerator.h"
#include "Tests/Fakes/DisplayText.h"
#include "Tests/Fakes/FakeResources.h"
#include "Tests/Fakes/FakeRunLoop.h"
#include "Tests/Fakes/LogRecorder.h"
#include "Tests/Fakes/RecordBuilder.h"

#include <gtest/gtest.h>
#include <initializer_list>
#include <string>

namespace spectrel {

/// A CDMA2000 generator whose template shows the named variables flat, each under its own name.
class C2KFixture : public testing::Test {
protected:
    explicit C2KFixture(std::initializer_list<std::string_view> variables)
    {
        auto layout = Dictionary::make();
        for (const std::string_view variable : variables)
            layout->set(variable, variable);
        resources.lists["C2KTemplate"] = layout;
        generator.getDisplayFromState(state);
        log.takeLog();
    }

    void deliver(ByteView message)
    {
        generator.updateState(state, message);
    }
    std::string shown(std::string_view variable)
    {
        return displayText((*state[StateKey::Display].dictionary())[variable]);
    }
    std::string display()
    {
        return displayText(state[StateKey::Display]);
    }

    FakeRunLoop time;
    LogRecorder log;
    FakeResources resources;
    const Context context {time, resources, log, log};
    Dictionary state;
    C2KLogGenerator generator {context};
};

/// A 1x record that holds subpackets, being put together.
class SubpacketRecord {
public:
    explicit SubpacketRecord(std::uint32_t code)
        : _bytes(RecordBuilder(code, 17).bytes())
    {
    }
    /// One more subpacket with these bytes behind its head of four.
    SubpacketRecord& add(std::uint8_t id, const Bytes& content)
    {
        return addWithSize(id, content.size() + 4, content);
    }
    /// The same, telling a size of its own.
    SubpacketRecord& addWithSize(std::uint8_t id, std::size_t size, const Bytes& content)
    {
        ++_bytes[14];
        _bytes.insert(_bytes.end(), {id, 0, static_cast<std::uint8_t>(size), static_cast<std::uint8_t>(size >> 8)});
        _bytes.insert(_bytes.end(), content.begin(), content.end());
        return *this;
    }
    SubpacketRecord& count(std::uint8_t number)
    {
        _bytes[14] = number;
        return *this;
    }
    operator ByteView() const
    {
        return _bytes;
    }

private:
    Bytes _bytes;
};

} // namespace spectrel
