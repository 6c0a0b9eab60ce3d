#include "LogGenerator/C2K/C2KLogGenerator.h"
#include "platform/scripted/ScriptedPlatform.h"
#include "tests/simulation/SimulatedLife.h"
#include "tests/support/RecordingLog.h"

#include <fmt/format.h>
#include <gmock/gmock.h>
#include <map>
#include <regex>
#include <set>

namespace pelorus::test {

namespace {

using namespace std::chrono_literals;
using testing::Contains;

/// An hour of a CDMA2000 handset's life on the real display, looked at every 2 s as the monitor does.
class DecodedCdmaLife : public testing::Test {
protected:
    DecodedCdmaLife()
    {
        platform.useResourceDirectory(PELORUS_SOURCE_DIR "/resources");
        C2KLogGenerator generator(platform);
        State state;
        double nextRefresh = 2;
        watch("Osprey CDMA", 5, 1h, [&](const SeenMessage& message) {
            if (message.seconds() > nextRefresh) {
                look(generator.generateLogUsingState(state));
                nextRefresh += 2;
            }
            generator.updateState(state, message.bytes());
        });
        std::vector<std::string> lines = log.take();
        std::copy_if(lines.begin(), lines.end(), std::back_inserter(errors),
                     [](const std::string& line) { return line.starts_with("<3>"); });
    }

    void look(const Value& display)
    {
        now.clear();
        collect(display, "");
        for (const auto& [row, text] : now)
            seen[row].insert(text);
        const bool isTalking = now["1x/State/Device State"] == "Traffic [8]";
        mixed += isTalking == (now["1x/RF/Tx AGC"] == "N/A") ? 1 : 0;
    }

    void collect(const Value& object, const std::string& path)
    {
        if (const std::string* text = object.string())
            now[path] = *text;
        else if (const Dictionary* group = object.dictionary())
            for (const auto& [key, value] : *group)
                if (!(key == "_sorted"))
                    collect(value, path + (path.empty() ? "" : "/") + shownName(std::string(key.text())));
    }
    static std::string shownName(const std::string& key) { return key.substr(key.find(';') + 1); }

    /// The numbers that a row showed, where it showed any.
    std::vector<double> numbers(const std::string& row)
    {
        std::vector<double> values;
        const std::regex number("^(?:\\(ref pilot\\) )?([+-]?[0-9.]+)[ %].*");
        std::smatch match;
        for (const std::string& text : seen[row])
            if (std::regex_match(text, match, number))
                values.push_back(std::stod(match[1]));
        return values;
    }
    void expectWithin(const std::string& row, double least, double most, std::size_t different)
    {
        const auto values = numbers(row);
        EXPECT_GE(values.size(), different) << row;
        for (const double value : values)
            EXPECT_TRUE(value >= least && value <= most) << row << " " << value;
    }

    ScriptedPlatform platform;
    RecordingLog log;
    std::vector<std::string> errors;
    std::map<std::string, std::string> now;
    std::map<std::string, std::set<std::string>> seen;
    int mixed = 0;
};

} // namespace

TEST_F(DecodedCdmaLife, FillsTheDisplayWithoutAnError)
{
    EXPECT_EQ(errors, std::vector<std::string>());
    EXPECT_GE(now.size(), 28U);
    for (const auto& [row, text] : now)
        EXPECT_NE(text, "") << row;
}

TEST_F(DecodedCdmaLife, ShowsPlausibleValuesThatMove)
{
    expectWithin("EV-DO/RF/Rx0 AGC", -105, -25, 20);
    expectWithin("EV-DO/RF/Tx AGC", -50, 23, 10);
    expectWithin("1x/RF/Rx0 AGC", -106, -24, 30);
    expectWithin("1x/RF/Tx AGC", -50, 23.5, 30);
    expectWithin("1x/State/Traffic FER", 0, 12, 50);
    expectWithin("EV-DO/Data Rates/Forward Link", 0, 3072, 100);
    expectWithin("EV-DO/Data Rates/Reverse Link", 0, 1843.2, 100);
    for (const int pilot : {12, 180, 348, 36, 204, 372, 60, 228, 396}) {
        expectWithin(fmt::format("1x/Pilots/Active Set/{}", pilot), -24.1, 0, 5);
        expectWithin(fmt::format("EV-DO/Pilots/Active Set/{}", pilot), -24.1, 0, 5);
        expectWithin(fmt::format("EV-DO/Pilots/Finger C/I/{}", pilot), -16.1, 14, 5);
    }
    EXPECT_EQ(mixed, 0) << "transmitter and second chain are shown in traffic only";
}

TEST_F(DecodedCdmaLife, ShowsEveryStateThatLasts)
{
    for (const char* state : {"Paging [6]", "Slotted mode sleep state [7]", "Traffic [8]"})
        EXPECT_THAT(seen["1x/State/Device State"], Contains(state));
    for (const char* state : {"Inactive [0]", "Idle [3]", "Connected [5]"})
        EXPECT_THAT(seen["EV-DO/State/Device State"], Contains(state));
    EXPECT_EQ(seen["1x/System/System ID (SID)"], (std::set<std::string>{"4182", "4190"}));
    EXPECT_EQ(seen["1x/System/Roaming Indicator"], (std::set<std::string>{"OFF [0]", "ON [1]"}));
    EXPECT_THAT(seen["EV-DO/Pilots/Serving PN Offset"], Contains("Invalid Value"));
    EXPECT_THAT(seen["EV-DO/Pilots/Active Set"], Contains("(none)"));
    EXPECT_TRUE(std::any_of(seen["1x/State/Traffic FER"].begin(), seen["1x/State/Traffic FER"].end(),
                            [](const std::string& text) { return text.ends_with("% (old)"); }));
}

} // namespace pelorus::test
