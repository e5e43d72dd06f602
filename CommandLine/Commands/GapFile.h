#pragma once

#include "Values/Moment.h"
#include "Values/Result.h"

#include <cstdint>
#include <string>

namespace spectrel {

/// The file beside a recording that tells where messages are missing: JSON Lines {"time": ..., "lost": messages}. It is
/// there only where some are.
class GapFile {
public:
    explicit GapFile(const std::string& recording);
    GapFile(const GapFile&) = delete;
    GapFile& operator=(const GapFile&) = delete;
    ~GapFile();

    /// What cannot be written waits for the next call and becomes one gap with it.
    Outcome add(Moment time, std::uint64_t lost);
    Outcome flush();

private:
    std::string _path;
    int _file = -1;
    Moment _time {}; // of the first message lost of those not written
    std::uint64_t _lost = 0; // not written
};

} // namespace spectrel
