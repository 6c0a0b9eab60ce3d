#pragma once

#include "platform/SystemLog.h"

#include <fmt/format.h>
#include <string>
#include <utility>
#include <vector>

namespace pelorus::test {

/// Listens to the system log as long as it lives.
class RecordingLog : public SystemLogSink {
public:
    RecordingLog() : previous(setSystemLogSink(this)) {}
    ~RecordingLog() override { setSystemLogSink(previous); }
    RecordingLog(const RecordingLog&) = delete;
    RecordingLog& operator=(const RecordingLog&) = delete;

    void write(int priority, std::string_view text) override
    {
        lines.push_back(fmt::format("<{}>{}", priority, text));
    }

    /// "<3>text" of every line since the last take().
    std::vector<std::string> take() { return std::exchange(lines, {}); }

private:
    SystemLogSink* previous;
    std::vector<std::string> lines;
};

} // namespace pelorus::test
