#pragma once

#include "LogGenerator/LogGenerator.h"
#include "platform/scripted/ScriptedPlatform.h"
#include "tests/support/PacketBuilder.h"
#include "tests/support/RecordingLog.h"

#include <fmt/format.h>
#include <gmock/gmock.h>
#include <regex>

namespace pelorus::test {

using namespace std::chrono_literals;

/// "%p" in place of every address.
inline std::string withoutAddresses(const std::string& line)
{
    static const std::regex address("0x[0-9a-f]+");
    return std::regex_replace(line, address, "%p");
}

inline std::string propertyListText(std::string_view content)
{
    return fmt::format("<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n<plist version=\"1.0\">{}</plist>\n",
                       content);
}

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
