#pragma once

#include "Values/Bytes.h"

#include <exception>
#include <string>

namespace spectrel {

/// The log code of a message as it is routed, "code 0xB0C2" or "code 0xFF0001"; says so when it has none.
std::string codeText(ByteView message);

/// The exception's class, readable, with what it says of itself where that says more.
std::string exceptionName(const std::exception& exception);

/// Two digits a byte.
std::string hexadecimal(ByteView bytes);

} // namespace spectrel
