#pragma once

#include "platform/SystemLog.h"

#include <chrono>
#include <string>

namespace pelorus {

/// The machine's system log, under the program's name. Where there is none, lines are dropped; it is looked
/// for again every second, for a connection tried at each of thousands of lines costs more than decoding
/// them.
class SyslogSink : public SystemLogSink {
public:
    explicit SyslogSink(std::string programName);
    ~SyslogSink() override;
    void write(int priority, std::string_view text) override;

private:
    bool somebodyListens();

    std::string ident; // syslog() keeps a pointer to it
    std::chrono::steady_clock::time_point nextLook;
    bool found = false;
};

} // namespace pelorus
