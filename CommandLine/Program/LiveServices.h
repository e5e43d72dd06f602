#pragma once

#include "Monitor/Session.h"
#include "Platform/Qt/QtClock.h"
#include "Platform/Qt/QtRunLoop.h"
#include "Platform/Sockets/SocketMessagePorts.h"
#include "Platform/Sockets/SocketTelephonyServer.h"

#include <string>

namespace spectrel {

/// What every program with a live session stands on: the run loop, the device's clock (installed), the message ports
/// and the telephony service.
class LiveServices {
public:
    LiveServices();
    ~LiveServices();
    LiveServices(const LiveServices&) = delete;
    LiveServices& operator=(const LiveServices&) = delete;

    QtRunLoop& runLoop()
    {
        return _runLoop;
    }
    const Clock& clock() const
    {
        return _clock;
    }
    Session::Services services()
    {
        return {_runLoop, _ports, _telephony};
    }
    /// A port prefix for a program that runs beside the application: the job's name and the process's number in it.
    static std::string portPrefixFor(const std::string& job);

private:
    QtRunLoop _runLoop;
    QtClock _clock;
    SocketMessagePorts _ports;
    SocketTelephonyServer _telephony;
};

} // namespace spectrel
