#pragma once

#include "Monitor/DisplayState.h"
#include "Monitor/MonitorModel.h"
#include "Monitor/Session.h"
#include "Monitor/SpectrelModelNode.h"
#include "Platform/Lifetime.h"
#include "Values/Bytes.h"
#include "Values/Dictionary.h"
#include "Values/List.h"

#include <chrono>
#include <cstddef>
#include <memory>
#include <string>
#include <string_view>

namespace spectrel {

/// Who hears of the model's news; every program that runs a session has one.
class SpectrelModelObserver {
public:
    virtual ~SpectrelModelObserver() = default;
    /// The display may have changed: read the tree again. At most once per timer tick, from the main queue.
    virtual void updateViewControllerFromModel() = 0;
    /// The session was opened or lost, or the reason why there is none has changed.
    virtual void sessionDidChange() { }
    /// The place on the time line, or how it moves, has changed.
    virtual void playbackDidChange() { }
};

/// The monitor model: a session that delivers messages, the state they are decoded into, and the display tree built
/// from it.
class SpectrelModel final : public MonitorModel, private SessionSink {
public:
    using Services = Session::Services;

    static constexpr std::chrono::milliseconds RefreshInterval = DisplayState::RefreshInterval;
    /// Message bytes applied between two refreshes; a faster service has to wait for the next one. The history keeps
    /// what came between refreshes, so that this bounds the memory. A radio sends a hundredth of it.
    static constexpr std::size_t LargestIntake = 8 * 1024 * 1024;
    /// The application's name on the message ports; other programs take one of their own in its place.
    static constexpr std::string_view ApplicationPrefix = "org.spectrel.Spectrel";

    /// Opens nothing.
    SpectrelModel(
        Services services, GeneratorFactory makeGenerator, SpectrelModelObserver& observer, std::string portPrefix);

    // The session.
    bool isConnected() const override
    {
        return _session.isConnected();
    }
    bool createPorts()
    {
        return _session.createPorts();
    }
    void destroyPorts()
    {
        _session.destroyPorts();
    }
    void configureGenerator()
    {
        _session.configureGenerator();
    }
    void startMonitor()
    {
        _session.start();
    }
    void restartMonitor() override
    {
        _session.restart();
    }
    const std::string& lostReason() const override
    {
        return _session.loss().text;
    }
    const Session& session() const
    {
        return _session;
    }

    // The display.
    void updateWithData(ByteView data);
    void refresh()
    {
        _session.refresh();
    }
    /// The root of the current tree, built at need; null without a generator.
    NodeRef topLevelNodes() override;
    NodeRef nodeAtPath(std::string_view path) override;
    /// What a snapshot saves; null without a generator.
    ListRef getSaveContents() override
    {
        return _display.saveContents();
    }
    /// What the messages are decoded into; who wants to hear of the changes asks there.
    DisplayState& displayState()
    {
        return _display;
    }
    const DisplayState& displayState() const
    {
        return _display;
    }

private:
    void useTechnology(const Value& technology) override;
    LogGenerator* generator() override
    {
        return _display.generator();
    }
    void receive(ByteView body) override
    {
        updateWithData(body);
    }
    void sessionDidTick() override;
    void sessionDidChange() override
    {
        _observer.sessionDidChange();
    }

    RunLoop& _runLoop;
    const Clock& _clock;
    SpectrelModelObserver& _observer;
    Lifetime _lifetime;
    std::size_t _intake = 0; // bytes applied since the last refresh
    DisplayState _display;
    NodeRef _nodes;
    std::unique_ptr<PathIndex> _nodesByPath; // set and cleared together with the tree
    Session _session;
};

} // namespace spectrel
