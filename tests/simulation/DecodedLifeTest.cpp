#include "LogGenerator/Osprey/GSM/OSP_GSMLogGenerator.h"
#include "LogGenerator/Osprey/UTRAN/UTRANLogGenerator.h"
#include "platform/SystemLog.h"
#include "platform/scripted/ScriptedPlatform.h"
#include "tests/simulation/SimulatedLife.h"

#include <gmock/gmock.h>

namespace pelorus::test {

namespace {

using namespace std::chrono_literals;

/// Keeps the lines of error priority.
class Errors : public SystemLogSink {
public:
    Errors() : previous(setSystemLogSink(this)) {}
    ~Errors() override { setSystemLogSink(previous); }
    void write(int priority, std::string_view text) override
    {
        if (priority == 3 && lines.size() < 10)
            lines.emplace_back(text);
    }
    std::vector<std::string> lines;

private:
    SystemLogSink* previous;
};

/// The rows that still show the template's placeholder, as "section: label".
void collectUnwritten(const Value& object, const std::string& path, std::vector<std::string>& found)
{
    if (const Dictionary* dictionary = object.dictionary())
        for (const auto& [key, value] : *dictionary) {
            if (value.string() && *value.string() == "-")
                found.push_back(path + std::string(key.text()));
            collectUnwritten(value, std::string(key.text()) + ": ", found);
        }
}

/// What an hour of a handset's life leaves unsaid on the real display.
template <class Generator> std::vector<std::string> unwrittenAfterAnHour(const char* technology)
{
    ScriptedPlatform platform;
    platform.useResourceDirectory(PELORUS_SOURCE_DIR "/resources");
    Generator generator(platform);
    State state;
    generator.getDisplayFromState(state);
    std::vector<std::string> found;
    collectUnwritten(generator.getDisplayFromState(state), "", found);
    EXPECT_GE(found.size(), 8U) << "rows before the first packet";
    found.clear();
    const Errors errors;
    EXPECT_NO_THROW(watch(technology, 5, 1h, [&generator](const SeenMessage& message) {
        generator.updateWithData(message.bytes());
    }));
    EXPECT_EQ(errors.lines, std::vector<std::string>());
    collectUnwritten(generator.getDisplayFromState(state), "", found);
    return found;
}

} // namespace

TEST(DecodedLife, OfAGsmHandsetFillsTheDisplayWithoutAnError)
{
    EXPECT_THAT(unwrittenAfterAnHour<OSP_GSMLogGenerator>("Osprey GSM"), testing::IsEmpty());
}

TEST(DecodedLife, OfAUtranHandsetFillsTheDisplayWithoutAnError)
{
    EXPECT_THAT(unwrittenAfterAnHour<UTRANLogGenerator>("Osprey UTRAN2"), testing::IsEmpty());
}

} // namespace pelorus::test
