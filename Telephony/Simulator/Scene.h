#pragma once

#include "Records/Technology.h"

#include <cstdint>
#include <string>
#include <string_view>

namespace spectrel {

/// What the simulated phone goes through.
enum class Scene : std::uint8_t {
    Still,
    Walk,
    Drive,
    Stress, // fast, and every record comes at every step
    Handover, // a drive with a connection all the time
    Tunnel, // a drive through tunnels without any signal
    Rejected, // a drive through an area that rejects the phone
    PingPong, // to and fro between two cells
    Overshoot, // a drive past a place where a far cell is the strongest
    Journey, // a drive from one radio technology to another
};

/// "still", "walk", "drive" and so on.
bool sceneNamed(std::string_view name, Scene& scene);
std::string_view sceneName(Scene scene);
/// All names, with `separator` between them.
std::string sceneNames(std::string_view separator);

/// Whether the simulated baseband of the technology can be put into the scene.
bool hasScene(Technology technology, Scene scene);
/// The technologies that can, by name: "lte, gsm, utran".
std::string technologiesOf(Scene scene);

/// How fast the phone moves, in metres a second.
struct Pace {
    double min;
    double max;
};
Pace paceOf(Scene scene);

} // namespace spectrel
