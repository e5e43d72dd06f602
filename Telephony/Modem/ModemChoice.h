#pragma once

#include "Telephony/Modem/ModemFacts.h"

#include <string>
#include <string_view>
#include <vector>

namespace spectrel {

/// The modem to listen to, null when there is none.
///
/// `wish`: a modem's number ("0"), its whole id, or its model or control port, whatever the case of their letters;
/// empty for any. Of several that fit, one that is registered comes first, then one that is enabled, then the lowest
/// number; but the one in use (`current`, an id) stays while it is enabled.
const ModemFacts* chooseModem(const std::vector<ModemFacts>& modems, std::string_view wish, std::string_view current);

/// How a modem is called in messages: "modem 0 (EM7455)".
std::string modemName(const ModemFacts& modem);

} // namespace spectrel
