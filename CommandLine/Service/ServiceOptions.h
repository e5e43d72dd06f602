#pragma once

#include "Records/Recording.h"
#include "Telephony/Simulator/Scene.h"
#include "Telephony/Sources/ReplaySource.h"

#include <chrono>
#include <cstdint>
#include <optional>
#include <string>

namespace spectrel {

/// What `--simulate` was asked for.
struct SimulateOptions {
    std::optional<Technology> technology;
    Scene scene = Scene::Drive;
    std::uint32_t seed = 1;
    double rate = 1;
    std::string file; // write a recording and end
    std::string truth; // with that: a file for what the simulated world decided; empty: none
    std::chrono::milliseconds duration = std::chrono::minutes(1);
};

/// The command line of `spectrel-telephonyd`, read. Exactly one source is set.
struct ServiceOptions {
    SimulateOptions simulate;
    ReplayOptions replay;
    std::string relay; // the stream's address
    std::optional<std::string> modem; // which one; empty: any
    std::optional<Technology> technology; // where a recording or a stream does not name it
    int readyDescriptor = -1;
    std::optional<std::chrono::milliseconds> statusInterval;
};

/// Reads the command line. An exit status when the program is done with that: after --help, --version or wrong usage,
/// each printed on the stream where it belongs.
std::optional<int> readServiceOptions(int argc, char** argv, ServiceOptions& options);

} // namespace spectrel
