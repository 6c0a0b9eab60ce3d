#include "platform/linux/SyslogSink.h"

#include <syslog.h>

namespace pelorus {

SyslogSink::SyslogSink(std::string programName) : ident(std::move(programName))
{
    ::openlog(ident.c_str(), 0, LOG_USER);
}

SyslogSink::~SyslogSink()
{
    ::closelog();
}

void SyslogSink::write(int priority, std::string_view text)
{
    // The number goes through as it is: one above 7 names a facility of its own as well.
    ::syslog(priority, "%.*s", static_cast<int>(text.size()), text.data());
}

} // namespace pelorus
