#pragma once

#include "Values/Bytes.h"

#include <cstddef>
#include <cstdint>

namespace spectrel {

/// The bytes of a stream that are not cut yet.
class StreamBuffer {
public:
    void append(ByteView bytes)
    {
        if (_start > 0) {
            _bytes.erase(_bytes.begin(), _bytes.begin() + static_cast<std::ptrdiff_t>(_start));
            _start = 0;
        }
        _bytes.insert(_bytes.end(), bytes.begin(), bytes.end());
    }
    ByteView bytes() const
    {
        return ByteView(_bytes).subspan(_start);
    }
    /// Takes bytes away at the front; a view of them stays valid until the next `append`.
    void drop(std::size_t count)
    {
        _start += count;
        _offset += count;
    }
    /// In the stream, of the first byte.
    std::uint64_t offset() const
    {
        return _offset;
    }

    bool isFinished = false; // no more bytes will come
    bool isSettled = false; // none have come for a moment

private:
    Bytes _bytes;
    std::size_t _start = 0;
    std::uint64_t _offset = 0;
};

} // namespace spectrel
