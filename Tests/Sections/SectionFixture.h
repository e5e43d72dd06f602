#pragma once

#include "LogGenerator/Template/SectionRegistry.h"
#include "Tests/Fakes/DisplayText.h"
#include "Tests/Fakes/LogRecorder.h"
#include "Tests/Fakes/RecordBuilder.h"
#include "Values/Dictionary.h"
#include "Values/List.h"

#include <gtest/gtest.h>
#include <string>
#include <vector>

namespace spectrel {

/// 256 texts: the names for the values from 0 on, `other` for those past them, and `named255` for 255.
inline std::vector<std::string> textsForEachByte(
    std::vector<std::string> names, const std::string& other, const std::string& named255 = {})
{
    names.resize(256, other);
    if (!named255.empty())
        names[255] = named255;
    return names;
}

/// How often the part is found in the text.
inline std::size_t countOf(std::string_view part, std::string_view text)
{
    std::size_t count = 0;
    for (std::size_t at = text.find(part); at != std::string_view::npos; at = text.find(part, at + part.size()))
        ++count;
    return count;
}

/// One section with a node of its own: deliver records, read the display and the log.
template <typename Section> class SectionFixture : public testing::Test {
protected:
    /// `node`: the container that the section writes into, a dictionary or a list.
    /// `diagnosticLog`: who listens to it, if anybody.
    explicit SectionFixture(Value node, DiagnosticLog* diagnosticLog = nullptr)
        : _node(std::move(node))
        , registry({.log = _recorder, .console = _recorder, .diagnosticLog = diagnosticLog})
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
    /// What the key shows for each value, 0 to 255, of the record's byte at the offset.
    std::vector<std::string> shownForEachByte(
        std::uint32_t code, RecordBuilder record, std::size_t offset, std::string_view key)
    {
        std::vector<std::string> texts;
        for (std::uint32_t value = 0; value < 256; ++value) {
            deliver(code, record.u8(offset, value));
            const std::string* text = (*_node.dictionary())[key].string();
            texts.push_back(text ? *text : "none");
        }
        return texts;
    }
    std::string log()
    {
        return _recorder.takeLog();
    }

private:
    LogRecorder _recorder;
    Value _node;

protected:
    SectionRegistry registry;
    Section section {registry};
};

} // namespace spectrel
