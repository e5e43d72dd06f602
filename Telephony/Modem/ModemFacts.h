#pragma once

#include "Records/Recording.h"

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace spectrel {

/// The kinds of cell that a cell-information record can hold.
enum class CellKind : std::uint8_t { GSM, UMTS, LTE };

/// One cell as a modem reports it; what it does not report is absent.
struct CellFacts {
    CellKind kind = CellKind::GSM;
    bool isServing = false;
    std::string operatorId; // MCC and MNC as digits, "00101" or "001001": text, or zeros and the MNC's length were lost
    std::optional<std::uint32_t> areaCode; // location area; tracking area for LTE
    std::optional<std::uint32_t> cellId;
    std::optional<std::uint32_t> channel; // ARFCN, UARFCN or E-ARFCN of the downlink
    std::optional<std::uint32_t> psc; // UMTS, primary scrambling code, 0 to 511
    std::optional<std::uint32_t> physicalCellId; // LTE, 0 to 503
    std::optional<std::uint32_t> rxLevel; // GSM, 0 to 63 (3GPP TS 45.008, 8.1.4)
    std::optional<double> power; // dBm: UMTS RSCP, LTE RSRP
    std::optional<double> quality; // dB: UMTS Ec/Io, LTE RSRQ
};

/// What the modem measures of the serving cell, of the technology in use.
struct SignalFacts {
    std::optional<double> rssi; // dBm
    std::optional<double> rscp; // dBm, UMTS
    std::optional<double> ecio; // dB, UMTS
    std::optional<double> rsrp; // dBm, LTE
    std::optional<double> rsrq; // dB, LTE
    std::optional<double> snr; // dB, LTE

    friend bool operator==(const SignalFacts&, const SignalFacts&) = default;
};

/// Where the modem is registered (3GPP location), when its cells cannot be listed.
struct LocationFacts {
    std::string operatorId; // digits, as in CellFacts
    std::optional<std::uint32_t> locationArea; // GSM, UMTS
    std::optional<std::uint32_t> trackingArea; // LTE
    std::optional<std::uint32_t> cellId;
};

/// The SIM, as far as modems report it; an empty text is not known. The IMSI is left where it is: nothing shows it.
struct SimFacts {
    std::string iccid;
    std::string operatorId; // digits: the home network
    std::string operatorName;
    std::vector<std::string> ownNumbers;

    friend bool operator==(const SimFacts&, const SimFacts&) = default;
};

/// A packet data connection; an empty text is not known. User name and password are left where they are.
struct BearerFacts {
    std::string id; // the profile's number, else the bearer's
    std::string apn;
    std::string type; // "IPv4", "IPv6" or "IPv4v6"
    std::string state; // "Active", "Suspended" or "Inactive"
    std::string interface; // the network interface
    std::string address;
    std::string ipv6Address;
    std::string gateway;
    std::vector<std::string> dns;
    std::optional<std::uint64_t> bytesReceived;
    std::optional<std::uint64_t> bytesSent;

    friend bool operator==(const BearerFacts&, const BearerFacts&) = default;
};

/// One modem as its service reports it now.
struct ModemFacts {
    std::string id; // the service's own name for it: an object path
    std::string model;
    std::string port; // the control port's name, such as "cdc-wdm0"
    bool isEnabled = false; // powered, and its radio in use
    bool isRegistered = false;
    std::optional<CellKind> cellKind; // the serving cell's, from the access technology
    std::optional<Technology> technology; // none while the access technology is not known
    std::string operatorId; // digits: where it is registered
    SignalFacts signal;
    std::optional<std::uint32_t> signalRate; // seconds, 0 for never, shared by all clients; none: it measures nothing
    std::optional<SimFacts> sim; // none: there is none; nothing in it: not known yet
    std::vector<BearerFacts> bearers;
};

/// A hexadecimal number without prefix, as modems report areas and cells ("8BE3"); none when it is anything else.
std::optional<std::uint32_t> hexadecimal(std::string_view text);

/// "MCC,MNC,LAC,CI[,TAC]", the last three hexadecimal, a zero for what is not known; none when it is anything else.
std::optional<LocationFacts> parseLocation(std::string_view text);

/// The serving cell, as far as the place of registration names it; none when nothing is known of it.
std::optional<CellFacts> registeredCell(const ModemFacts& modem, const std::optional<LocationFacts>& location);

/// Five or six digits: MCC and MNC.
bool isOperatorId(std::string_view text);

/// "001-01" for "00101"; the text as it is when it is no MCC and MNC.
std::string networkName(std::string_view operatorId);

} // namespace spectrel
