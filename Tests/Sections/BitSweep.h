#pragma once

#include "Values/Bytes.h"

#include <cstdio>
#include <functional>
#include <gtest/gtest.h>
#include <string>
#include <vector>

namespace spectrel {

/// A field as a record's layout has it: `count` bits from bit `first` of a byte on, and the text it is to show.
/// An empty text means that the key is not there.
struct LaidOutField {
    const char* key;
    std::size_t byte;
    unsigned first;
    unsigned count;
    std::function<std::string(unsigned raw)> text;
};

/// A text as C's printf makes it.
template <typename... Arguments> std::string printed(const char* format, Arguments... arguments)
{
    char text[100];
    std::snprintf(text, sizeof text, format, arguments...);
    return text;
}

inline std::string plain(unsigned raw)
{
    return printed("%d", static_cast<int>(raw));
}

/// Shows records whose swept bytes are all zeros, all ones and a walking one, and compares each whole display, its
/// order included.
class BitSweep {
public:
    /// Answers a record's display, or one entry of it, as `displayText` writes it.
    using Show = std::function<std::string(const Bytes& record)>;

    BitSweep(std::vector<LaidOutField> fields, Show show)
        : _fields(std::move(fields))
        , _show(std::move(show))
    {
    }

    /// Sweeps the bytes `from` to `to` - 1; the record's other bytes stay, and no field may stand in them.
    void run(Bytes record, std::size_t from, std::size_t to) const
    {
        expectAfterFilling(record, from, to, 0x00);
        expectAfterFilling(record, from, to, 0xFF);
        std::fill(record.begin() + static_cast<long>(from), record.begin() + static_cast<long>(to), std::uint8_t(0));
        for (std::size_t bit = from * 8; bit < to * 8; ++bit) {
            record[bit / 8] = static_cast<std::uint8_t>(1u << bit % 8);
            EXPECT_EQ(_show(record), expected(record)) << "byte " << bit / 8 << " bit " << bit % 8;
            record[bit / 8] = 0;
        }
    }

private:
    void expectAfterFilling(Bytes record, std::size_t from, std::size_t to, std::uint8_t byte) const
    {
        std::fill(record.begin() + static_cast<long>(from), record.begin() + static_cast<long>(to), byte);
        EXPECT_EQ(_show(record), expected(record)) << "all " << int(byte);
    }

    static unsigned rawValue(const Bytes& record, const LaidOutField& field)
    {
        unsigned raw = 0;
        for (unsigned position = 0; position < field.count; ++position) {
            const std::size_t bit = field.byte * 8 + field.first + position;
            raw |= (record.at(bit / 8) >> bit % 8 & 1u) << position;
        }
        return raw;
    }

    std::string expected(const Bytes& record) const
    {
        std::string text = "{";
        for (const LaidOutField& field : _fields) {
            if (const std::string shown = field.text(rawValue(record, field)); !shown.empty())
                text += (text.size() > 1 ? ", \"" : "\"") + std::string(field.key) + "\": \"" + shown + "\"";
        }
        return text + "}";
    }

    std::vector<LaidOutField> _fields;
    Show _show;
};

} // namespace spectrel
