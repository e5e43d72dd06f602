#pragma once

#include <cstdint>
#include <string_view>

/// What programs and the telephony service say to each other over message ports; every body is a property list.
namespace spectrel::TelephonyProtocol {

/// The service's well-known port.
inline constexpr std::string_view ServicePort = "org.spectrel.Telephony";

/// A request for a log channel: {"CreateLogChannel": <local port name>} with this message id, answered by
/// {"Domain": integer, "Error": integer, "PortName": text}. The port name is the channel's, for requests of id 0.
inline constexpr std::int32_t CreateLogChannelId = 1;
inline constexpr const char* CreateLogChannelKey = "CreateLogChannel";
inline constexpr const char* DomainKey = "Domain";
inline constexpr const char* ErrorKey = "Error";
inline constexpr const char* PortNameKey = "PortName";

/// Values under "Error".
enum class ChannelError : std::int32_t {
    None = 0,
    MalformedRequest = 22, // no dictionary with a local port name
    NotReady = 11, // the baseband is not known yet
    NoSuchPort = 2, // nobody serves the local port
    TooManyChannels = 24,
};

/// Requests on a log channel, and every log message from it, have this id.
inline constexpr std::int32_t LogChannelId = 0;
/// {"GetTechnology": "GetTechnology"}, answered by {"GetTechnology": <technology constant>}.
inline constexpr const char* GetTechnologyKey = "GetTechnology";
/// The start command: {"SetState": "Streaming"} with the codes to stream of either stream, not answered.
inline constexpr const char* SetStateKey = "SetState";
inline constexpr const char* StreamingState = "Streaming";
inline constexpr const char* OrdinaryCodesKey = "SetZephyrLogCodes";
inline constexpr const char* ExtraCodesKey = "SetRkExtraCodes";
/// Between log messages, on the client's port: {"Lost": integer} with this message id says that so many messages that
/// the client had asked for were dropped before the next one, because it was too slow. Who does not care ignores the
/// id.
inline constexpr std::int32_t LossId = 2;
inline constexpr const char* LostKey = "Lost";
/// A request that cannot be understood is answered by {"Error": text} where an answer is wanted.

} // namespace spectrel::TelephonyProtocol
