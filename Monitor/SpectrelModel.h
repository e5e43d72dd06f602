#pragma once

#include "Monitor/DisplayState.h"
#include "Monitor/MonitorModel.h"
#include "Monitor/SpectrelModelNode.h"
#include "Platform/MessagePort.h"
#include "Platform/RunLoop.h"
#include "Platform/TelephonyServer.h"
#include "Values/Bytes.h"
#include "Values/Dictionary.h"
#include "Values/List.h"

#include <chrono>
#include <memory>
#include <optional>
#include <string>
#include <string_view>

namespace spectrel {

/// Who is told of the model's news; every program that runs a session has one.
class SpectrelModelObserver {
public:
    virtual ~SpectrelModelObserver() = default;
    /// The display may have changed: read the tree again. At most once per timer tick, from the main queue.
    virtual void updateViewControllerFromModel() = 0;
    /// The session was opened or lost, or the reason why there is none has changed.
    virtual void sessionDidChange() { }
    /// The place on the time line, or how it moves, has changed.
    virtual void playbackDidChange() { }
    /// One inbound message body. False keeps it from being applied: a recorder wants the bytes alone.
    virtual bool modelShouldApply(ByteView)
    {
        return true;
    }
};

/// The monitor model: the log channel to the telephony service, the state that the generator fills, and the display
/// tree built from it.
class SpectrelModel final : public MonitorModel {
public:
    /// What the model needs of the platform; all outlive it.
    struct Services {
        RunLoop& runLoop;
        MessagePorts& ports;
        TelephonyServer& telephony;
    };

    static constexpr std::chrono::milliseconds RefreshInterval {2000};
    static constexpr std::chrono::seconds RetryDelay {5};
    static constexpr std::chrono::seconds RequestTimeout {1};
    /// Message bytes applied between two refreshes; a faster service has to wait for the next one. The history keeps
    /// what came between refreshes, so that this bounds the memory. A radio sends a hundredth of it.
    static constexpr std::size_t LargestIntake = 8 * 1024 * 1024;
    /// The application's name on the message ports; other programs take one of their own in its place.
    static constexpr std::string_view ApplicationPrefix = "org.spectrel.Spectrel";
    static constexpr std::string_view PortSuffix = ".BasebandStateReport.LogChannel"; // of every local port

    /// Opens nothing. The local port is named `portPrefix` + `PortSuffix`.
    SpectrelModel(Services services, SpectrelModelObserver& observer, std::string portPrefix);
    ~SpectrelModel() override;
    SpectrelModel(const SpectrelModel&) = delete;
    SpectrelModel& operator=(const SpectrelModel&) = delete;

    // The session.
    bool isConnected() const override;
    bool createPorts();
    void destroyPorts();
    void configureGenerator();
    void startMonitor();
    void restartMonitor() override;
    /// Why there is no session, as the system log told it last, without its decoration; empty while there is one.
    const std::string& lostReason() const override
    {
        return _lostReason;
    }

    // The display.
    void updateWithData(ByteView data);
    void refresh();
    /// The root of the current tree, built at need; null without a generator.
    NodeRef topLevelNodes() override;
    NodeRef nodeAtPath(std::string_view path) override;
    /// What a snapshot saves; null without a generator.
    ListRef getSaveContents() override;
    /// The same for a program that is about to end: the messages since the last refresh are folded in first, and the
    /// message being applied, if one is.
    ListRef getLastContents();

    /// What the messages are decoded into; who wants to hear of the changes asks there.
    DisplayState& displayState()
    {
        return _display;
    }
    const Dictionary& state() const
    {
        return _display.state();
    }
    const LogGenerator* logGenerator() const
    {
        return _display.generator();
    }
    /// The message being applied right now; empty otherwise.
    ByteView messageInProgress() const
    {
        return _display.messageInProgress();
    }
    /// The technology value that the service answered last; empty before.
    const std::string& technology() const
    {
        return _technology;
    }

private:
    void handleMessage(std::int32_t id, ByteView body) noexcept;
    void handleInvalidation(const LocalMessagePort* port);
    bool openLogChannel(const std::string& localName, std::string& serviceName);
    bool startSession();
    void closePorts();
    void announceChange();
    void reloadScreens();
    RunLoop::Job whileAlive(void (SpectrelModel::*operation)());
    void fail(const char* format, ...) __attribute__((format(printf, 2, 3)));

    Services _services;
    SpectrelModelObserver& _observer;
    std::string _portPrefix;
    std::string _lostReason; // of the latest attempt to open a session
    bool _attemptHasReason = false;
    bool _announcedConnected = false; // what the observer was told last
    std::string _announcedReason;
    std::string _technology;
    std::shared_ptr<bool> _alive; // jobs on the queue hold it weakly: they end with the model

    std::shared_ptr<LocalMessagePort> _recvPort;
    std::shared_ptr<RemoteMessagePort> _sendPort;
    std::unique_ptr<Timer> _displayUpdateTimer;
    std::size_t _intake = 0; // bytes applied since the last refresh
    DisplayState _display;
    NodeRef _nodes;
    std::unique_ptr<PathIndex> _nodesByPath; // set and cleared together with the tree
};

} // namespace spectrel
