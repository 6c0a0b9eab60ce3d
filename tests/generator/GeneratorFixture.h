#pragma once

#include "LogGenerator/LogGenerator.h"
#include "platform/scripted/ScriptedPlatform.h"
#include "tests/support/PacketBuilder.h"
#include "tests/support/RecordingLog.h"
#include "tests/support/Texts.h"

#include <gmock/gmock.h>

namespace pelorus::test {

using namespace std::chrono_literals;

/// A scripted machine, a state and the system log.
class GeneratorFixture : public testing::Test {
protected:
    std::vector<std::string> logged()
    {
        auto lines = log.take();
        for (std::string& line : lines)
            line = withoutAddresses(line);
        return lines;
    }
    /// The lines of error priority since the last call.
    std::vector<std::string> errors()
    {
        auto lines = logged();
        std::erase_if(lines, [](const std::string& line) { return !line.starts_with("<3>"); });
        return lines;
    }

    RecordingLog log;
    ScriptedPlatform platform;
    State state;
};

} // namespace pelorus::test
