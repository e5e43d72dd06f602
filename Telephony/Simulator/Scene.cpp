#include "Telephony/Simulator/Scene.h"

#include "Values/Table.h"

#include <algorithm>
#include <array>

namespace spectrel {

namespace {

using enum Technology;

/// Technologies, a bit each.
constexpr unsigned bit(Technology technology)
{
    return 1U << static_cast<unsigned>(technology);
}
constexpr unsigned All = bit(LTE) | bit(GSM) | bit(UTRAN) | bit(CDMA) | bit(IFX);

struct SceneRow {
    std::string_view name;
    Scene scene;
    Pace pace;
    unsigned technologies;
};

constexpr Pace Driving {6, 22};

constexpr std::array<SceneRow, 10> Scenes {{
    {"still", Scene::Still, {0, 0}, All},
    {"walk", Scene::Walk, {0.8, 2}, All},
    {"drive", Scene::Drive, Driving, All},
    {"stress", Scene::Stress, {30, 50}, All},
    {"handover", Scene::Handover, Driving, All},
    {"tunnel", Scene::Tunnel, Driving, All},
    {"rejected", Scene::Rejected, Driving, bit(GSM)}, // the others' records hold no registration
    {"ping-pong", Scene::PingPong, {10, 14}, All},
    {"overshoot", Scene::Overshoot, Driving, All},
    {"journey", Scene::Journey, Driving, bit(LTE) | bit(GSM) | bit(UTRAN)},
}};

const SceneRow& rowOf(Scene scene)
{
    return *std::ranges::find(Scenes, scene, &SceneRow::scene);
}

void appendTo(std::string& list, std::string_view separator, std::string_view name)
{
    if (!list.empty())
        list += separator;
    list += name;
}

} // namespace

bool sceneNamed(std::string_view name, Scene& scene)
{
    const auto* row = findRow(Scenes, name, &SceneRow::name);
    if (row)
        scene = row->scene;
    return row != nullptr;
}

std::string_view sceneName(Scene scene)
{
    return rowOf(scene).name;
}

std::string sceneNames(std::string_view separator)
{
    std::string names;
    for (const SceneRow& row : Scenes)
        appendTo(names, separator, row.name);
    return names;
}

bool hasScene(Technology technology, Scene scene)
{
    return (rowOf(scene).technologies & bit(technology)) != 0;
}

std::string technologiesOf(Scene scene)
{
    std::string names;
    for (const Technology technology : {LTE, GSM, UTRAN, CDMA, IFX}) {
        if (hasScene(technology, scene))
            appendTo(names, ", ", technologyName(technology));
    }
    return names;
}

Pace paceOf(Scene scene)
{
    return rowOf(scene).pace;
}

} // namespace spectrel
