#pragma once

#include "Platform/SystemLog.h"

namespace spectrel {

/// The platform's system log, under the identity "spectrel". Only failures are wanted: traces, a line for each section
/// and record, stay out of it.
class SyslogLog final : public SystemLog {
public:
    SyslogLog();
    ~SyslogLog() override;
    /// The raw priority is handed on as it is. A zero byte ends the line.
    void write(int priority, std::string_view text) override;
};

} // namespace spectrel
