#pragma once

#include "Values/Bytes.h"

#include <cstdint>

namespace spectrel {

/// Packs fields one after the other, the lowest bit of the first at the lowest bit of the first byte.
class BitPacker {
public:
    /// The low `count` bits of the value.
    BitPacker& field(unsigned count, std::uint32_t value);
    /// Bits that hold nothing.
    BitPacker& gap(unsigned count)
    {
        return field(count, 0);
    }
    /// The bytes so far; the last one is filled up with zeros.
    const Bytes& bytes() const
    {
        return _bytes;
    }

private:
    Bytes _bytes;
    unsigned _used = 0; // bits of the last byte; 0: it is full, or there is none
};

/// A level as a field counts it: whole steps of 1/stepsPerUnit above `min`, as near as the field's `count` bits
/// can hold.
std::uint32_t levelSteps(double level, double min, double stepsPerUnit, unsigned count);

} // namespace spectrel
