#pragma once

#include "Platform/Clock.h"
#include "Platform/Console.h"
#include "Platform/DiagnosticLog.h"
#include "Platform/Resources.h"
#include "Platform/SystemLog.h"

namespace spectrel {

/// What the decoding and the session read and write beside their messages. A program makes one and hands it in; copies
/// refer to the same things, which outlive them all. What is left out is nobody's: nothing is read, nobody listens.
struct Context {
    const Clock& clock = Clock::utc();
    const Resources& resources = Resources::none();
    SystemLog& log = SystemLog::none();
    Console& console = Console::none();
    DiagnosticLog* diagnosticLog = nullptr;
};

} // namespace spectrel
