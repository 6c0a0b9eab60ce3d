#pragma once

#include "platform/SystemLog.h"

#include <string>

namespace pelorus {

/// The machine's system log, under the program's name.
class SyslogSink : public SystemLogSink {
public:
    explicit SyslogSink(std::string programName);
    ~SyslogSink() override;
    void write(int priority, std::string_view text) override;

private:
    std::string ident; // syslog() keeps a pointer to it
};

} // namespace pelorus
