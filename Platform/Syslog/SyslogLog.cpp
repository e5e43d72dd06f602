#include "Platform/Syslog/SyslogLog.h"

#include <syslog.h>

namespace spectrel {

SyslogLog::SyslogLog()
    : SystemLog(Priority::Error)
{
    ::openlog("spectrel", LOG_PID, LOG_USER);
}

SyslogLog::~SyslogLog()
{
    ::closelog();
}

void SyslogLog::write(int priority, std::string_view text)
{
    ::syslog(priority, "%.*s", static_cast<int>(text.size()), text.data());
}

} // namespace spectrel
