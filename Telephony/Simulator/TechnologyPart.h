#pragma once

#include "Telephony/Simulator/Baseband.h"
#include "Telephony/Simulator/Coverage.h"

namespace spectrel {

/// One technology of a phone that has several, on the road that they share. While another one serves, its cells are
/// only measured.
class TechnologyPart : public Baseband {
public:
    /// A step along the road while another technology serves.
    virtual void advanceAway() = 0;
    virtual Coverage coverage() const = 0;
    /// dB of the serving cell above what cell selection asks for; only while this technology serves.
    virtual double servingMargin() const = 0;
    virtual CellName servingCell() const = 0;
    /// With a channel of its own: the network decides where the phone goes.
    virtual bool isConnected() const = 0;
    /// May be left: no procedure is under way.
    virtual bool isSettled() const = 0;
    /// Camps on the best cell, on the way from `from`.
    virtual void arrive(Technology from, MoveKind how) = 0;
    virtual void leave() = 0;
    /// The best cells of the technologies of lower priority, for the records.
    virtual void setOthers(const Coverage& utran, const Coverage& gsm) = 0;
};

/// Over a world that has these operations under the same names.
template <typename World> class SteadyPart final : public TechnologyPart {
public:
    SteadyPart(Technology technology, std::uint32_t seed, std::span<const Cadence<World>> cadences)
        : _baseband(technology, Scene::Journey, seed, cadences)
    {
    }
    Technology technology() const override
    {
        return _baseband.technology();
    }
    void greet(Moment now, const Emit& emit) const override
    {
        _baseband.greet(now, emit);
    }
    void advance(Moment now, const Emit& emit) override
    {
        _baseband.advance(now, emit);
    }
    std::span<const Move> moves() const override
    {
        return _baseband.moves();
    }
    void advanceAway() override
    {
        world().advanceAway(Step);
    }
    Coverage coverage() const override
    {
        return world().coverage();
    }
    double servingMargin() const override
    {
        return world().servingMargin();
    }
    CellName servingCell() const override
    {
        return world().servingName();
    }
    bool isConnected() const override
    {
        return world().isOnOwnChannel();
    }
    bool isSettled() const override
    {
        return world().isSettled();
    }
    void arrive(Technology from, MoveKind how) override
    {
        world().arrive(from, how);
    }
    void leave() override
    {
        world().leave();
    }
    void setOthers(const Coverage& utran, const Coverage& gsm) override
    {
        world().setOthers(utran, gsm);
    }

private:
    World& world()
    {
        return _baseband.world();
    }
    const World& world() const
    {
        return _baseband.world();
    }
    SteadyBaseband<World> _baseband;
};

std::unique_ptr<TechnologyPart> makeLTEPart(std::uint32_t seed);
std::unique_ptr<TechnologyPart> makeUTRANPart(std::uint32_t seed);
std::unique_ptr<TechnologyPart> makeGSMPart(std::uint32_t seed);

} // namespace spectrel
