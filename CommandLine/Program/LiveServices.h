#pragma once

#include "Monitor/Session.h"
#include "Platform/Context.h"
#include "Platform/Qt/QtRunLoop.h"
#include "Platform/Sockets/SocketMessagePorts.h"
#include "Platform/Sockets/SocketTelephonyServer.h"

#include <string>

namespace spectrel {

/// What every program with a live session stands on: the program's context, the run loop, the message ports and
/// the telephony service.
class LiveServices {
public:
    /// What the context refers to outlives this.
    explicit LiveServices(const Context& context);
    LiveServices(const LiveServices&) = delete;
    LiveServices& operator=(const LiveServices&) = delete;

    QtRunLoop& runLoop()
    {
        return _runLoop;
    }
    const Clock& clock() const
    {
        return _context.clock;
    }
    const Context& context() const
    {
        return _context;
    }
    Session::Services services()
    {
        return {_runLoop, _ports, _telephony, _context};
    }
    /// A port prefix for a program that runs beside the application: the job's name and the process's number in it.
    static std::string portPrefixFor(const std::string& job);

private:
    Context _context;
    QtRunLoop _runLoop;
    SocketMessagePorts _ports;
    SocketTelephonyServer _telephony;
};

} // namespace spectrel
