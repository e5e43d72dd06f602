#pragma once

#include "Telephony/Simulator/Move.h"
#include "Values/Moment.h"
#include "Values/Result.h"

#include <fstream>
#include <memory>
#include <string>

namespace spectrel {

/// What a simulated world decided, in JSON Lines: `{"time": …, "from": CELL, "to": CELL, "cause": {"kind": …, "rule":
/// …}}`, a CELL being `{"technology": …, "channel": …, "id": …, "cell": …}`. Lines of first cells have neither `from`
/// nor `cause`.
class TruthFile {
public:
    /// Makes the file, or overwrites one.
    static Result<std::unique_ptr<TruthFile>> create(const std::string& path);

    void write(Moment time, const Move& move);
    /// Whether everything was written.
    Outcome finish();

private:
    explicit TruthFile(const std::string& path)
        : _file(path, std::ios::binary | std::ios::trunc)
    {
    }
    std::ofstream _file;
};

/// The line of one move, without its end.
std::string truthLine(Moment time, const Move& move);

} // namespace spectrel
