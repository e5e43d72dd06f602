#pragma once

namespace spectrel {

/// What a phone wants of the radio.
struct Demand {
    bool signalling = false; // an update of its location, a service request
    bool call = false; // a voice call
    bool session = false; // a packet data context is open...
    bool transfer = false; // ... and something is being transferred

    /// It takes a connection.
    bool connection() const
    {
        return signalling || call || transfer;
    }
    /// It takes a channel of its own.
    bool dedicated() const
    {
        return call || transfer;
    }
};

/// Adds up how long something has held; starts anew when it does not.
template <typename Duration> void keepTime(Duration& held, bool holds, Duration step)
{
    held = holds ? held + step : Duration::zero();
}

} // namespace spectrel
