#pragma once

#include "LogGenerator/Template/Base.h"
#include "Platform/Dictionary.h"
#include "Platform/List.h"
#include "Tests/Fakes/DisplayText.h"
#include "Tests/Fakes/LogRecorder.h"
#include "Tests/Fakes/RecordBuilder.h"

#include <gtest/gtest.h>
#include <string>

namespace spectrel {

/// One section with a node of its own: deliver records, read the display and the log.
template <typename Section> class SectionFixture : public testing::Test {
protected:
    /// `node`: the container that the section writes into, a dictionary or a list.
    explicit SectionFixture(Value node)
        : _node(std::move(node))
    {
        section.updateSectionRef(_node);
        _recorder.takeLog();
    }

    void deliver(std::uint32_t code, ByteView record)
    {
        section.updateWithData(RecordView(record), code);
    }
    void deliverPropertyList(std::uint32_t code, const Value& payload)
    {
        deliver(code, RecordBuilder::withPropertyList(code, payload));
    }
    std::string display() const
    {
        return displayText(_node);
    }
    std::string shown(std::string_view key) const
    {
        return displayText((*_node.dictionary())[key]);
    }
    /// One entry of a list section, and how many there are.
    std::string shownEntry(std::size_t position) const
    {
        return displayText(position < shownCount() ? (*_node.list())[position] : Value());
    }
    std::size_t shownCount() const
    {
        return _node.list()->count();
    }
    std::string log()
    {
        return _recorder.takeLog();
    }

    ClassDictionary classDict;
    CodeDictionary codeDictionary;
    Section section {classDict, codeDictionary};

private:
    LogRecorder _recorder;
    Value _node;
};

} // namespace spectrel
