#pragma once

#include "Platform/Clock.h"
#include "Records/Recording.h"
#include "Telephony/Simulator/Journey.h"
#include "Telephony/Simulator/Move.h"
#include "Values/Bytes.h"

#include <chrono>
#include <functional>
#include <memory>
#include <span>

namespace spectrel {

/// A simulated baseband: a phone in its world, which moves in steps and reports in log records.
class Baseband {
public:
    /// How far the world moves at once; cadences are multiples of it.
    static constexpr std::chrono::milliseconds Step {100};
    using Emit = std::function<void(ByteView record)>;

    virtual ~Baseband() = default;
    /// May be another one after a step: the records of that step are the old one's, and a listener is to be greeted
    /// anew.
    virtual Technology technology() const = 0;
    /// The slow records, which a new channel gets at once.
    virtual void greet(Moment now, const Emit& emit) const = 0;
    /// Moves by one step and reports what is due then, stamped with `now`.
    virtual void advance(Moment now, const Emit& emit) = 0;
    /// What its world decided in the last step; before the first step, where it began.
    virtual std::span<const Move> moves() const = 0;
};

/// One kind of record and how often it comes.
template <typename World> struct Cadence {
    std::chrono::milliseconds interval;
    bool atStart; // a slow record, which a new channel gets at once
    Bytes (*make)(const World& world, Moment time);
};

/// A baseband whose records come steadily. The same seed gives the same drive.
///
/// `World` is built from a scene and a seed and has `advance(std::chrono::milliseconds)` and `moves()`. Records within
/// a step come in the order of the cadences; one that `make` leaves empty is not sent.
template <typename World> class SteadyBaseband final : public Baseband {
public:
    /// `cadences` outlive the baseband.
    SteadyBaseband(Technology technology, Scene scene, std::uint32_t seed, std::span<const Cadence<World>> cadences)
        : _technology(technology)
        , _everyStep(scene == Scene::Stress)
        , _world(scene, seed)
        , _cadences(cadences)
    {
    }

    Technology technology() const override
    {
        return _technology;
    }
    void greet(Moment now, const Emit& emit) const override
    {
        for (const auto& cadence : _cadences) {
            if (cadence.atStart)
                report(cadence, now, emit);
        }
    }
    void advance(Moment now, const Emit& emit) override
    {
        _world.advance(Step);
        _elapsed += Step;
        for (const auto& cadence : _cadences) {
            if (_everyStep || _elapsed % cadence.interval == std::chrono::milliseconds::zero())
                report(cadence, now, emit);
        }
    }

    std::span<const Move> moves() const override
    {
        return _world.moves();
    }
    World& world()
    {
        return _world;
    }
    const World& world() const
    {
        return _world;
    }

private:
    void report(const Cadence<World>& cadence, Moment now, const Emit& emit) const
    {
        if (const Bytes record = cadence.make(_world, now); !record.empty())
            emit(record);
    }

    Technology _technology;
    bool _everyStep;
    World _world;
    std::span<const Cadence<World>> _cadences;
    std::chrono::milliseconds _elapsed {0};
};

/// The simulated baseband of a technology; null where it has no such scene. On a journey it begins with the technology.
std::unique_ptr<Baseband> makeBaseband(Technology technology, Scene scene, std::uint32_t seed);

// One for each technology that can be simulated.
std::unique_ptr<Baseband> makeCDMABaseband(Scene scene, std::uint32_t seed);
std::unique_ptr<Baseband> makeIFXBaseband(Scene scene, std::uint32_t seed);
std::unique_ptr<Baseband> makeLTEBaseband(Scene scene, std::uint32_t seed);
std::unique_ptr<Baseband> makeGSMUMTSBaseband(Scene scene, std::uint32_t seed);
std::unique_ptr<Baseband> makeUTRANBaseband(Scene scene, std::uint32_t seed);

} // namespace spectrel
