#pragma once

#include "Platform/Clock.h"
#include "Telephony/Reports/GSMUMTSReports.h"
#include "Values/Bytes.h"

#include <span>

/// Records of a GSM/UMTS phone's mobility management and of the network it is on.
namespace spectrel {

/// 0x7131, 16 bytes: circuit-switched mobility management.
Bytes mmStateRecord(const MMReport& report, Moment time);

/// 0x7130, 16 bytes: packet-switched mobility management.
Bytes gmmStateRecord(const GMMReport& report, Moment time);

/// 0x7132, 16 bytes: the registration and how the network is chosen.
Bytes registrationRecord(const RegistrationReport& report, Moment time);

/// 0x7135, 32 bytes: the serving network. Without one its digits are filler (0xF).
Bytes servingNetworkRecord(const NetworkReport& report, Moment time);

/// 0x7150: the equivalent networks, six digit bytes each (country and network digits in turn; network 01 as 001) at a
/// stride of three: an entry's last three bytes are the next one's first three. Networks that do not share them with
/// the one before, and all after it, are left out.
Bytes equivalentNetworksRecord(std::span<const PLMN> networks, Moment time);

} // namespace spectrel
