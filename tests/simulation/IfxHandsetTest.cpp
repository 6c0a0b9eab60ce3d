#include "LogGenerator/GSM/GSMLogGenerator.h"
#include "platform/PropertyList.h"
#include "platform/scripted/ScriptedPlatform.h"
#include "tests/simulation/SimulatedLife.h"
#include "tests/support/RecordingLog.h"

#include <cmath>
#include <fmt/format.h>
#include <gmock/gmock.h>
#include <map>
#include <set>

namespace pelorus::test {

namespace {

using namespace std::chrono_literals;
using testing::ElementsAre;
using testing::IsEmpty;

/// The first number in a text such as "-71 dBm".
double numberIn(const Value& text)
{
    return text.string() ? std::stod(*text.string()) : NAN;
}

/// An hour of an IFX handset's life, as its generator shows it.
class IfxHandsetLife : public testing::TestWithParam<std::uint64_t> {
protected:
    IfxHandsetLife()
    {
        watch("IFX", GetParam(), 1h, [this](const SeenMessage& message) { see(message); });
    }

    void see(const SeenMessage& message)
    {
        now = message.seconds();
        if (messages++ > 0)
            expect(now - last >= 0.5 && now - last <= 1, "once or twice a second");
        last = now;
        expect(message.code() == 0, "a log code");
        generator.updateState(state, message.bytes());
        const Value display = state.at("Display");
        ASSERT_NE(display.dictionary(), nullptr);
        std::vector<std::string> names;
        for (const auto& [name, section] : *display.dictionary())
            names.emplace_back(name.text());
        ++layouts[names];
        if (display.dictionary()->find("Serving Cell")) {
            seeServingCell(*display.dictionary()->at("Serving Cell").dictionary());
            seeNeighbours(*display.dictionary()->at("Neighbor Cells").array());
        }
        if (const Value channel = display.dictionary()->at("Dedicated Channel"))
            seeChannel(*channel.dictionary());
        if (const Value cells = display.dictionary()->at("UMTS Cells"))
            for (const Value& cell : cells.array()->elements) {
                expect(cell.dictionary()->at("Channel") == Value("10638"), "a group of one entry");
                const double ratio = numberIn(cell.dictionary()->at("Ec/N0"));
                expect(ratio >= -12.05 && ratio < 0, "Ec/N0");
            }
    }

    void seeServingCell(const Dictionary& cell)
    {
        expect(cell.at("PLMN") == Value("001 01"), "PLMN");
        channel = *cell.at("Channel").string();
        channels.insert(channel);
        const double level = numberIn(cell.at("RxLev").dictionary()->at("Average"));
        expect(level >= -110 && level <= -47, "level");
        expect(numberIn(cell.at("Selection").dictionary()->at("C1")) == level + 104, "C1");
        levels.insert(level);
    }

    void seeNeighbours(const Array& cells)
    {
        fewest = std::min(fewest, cells.elements.size());
        most = std::max(most, cells.elements.size());
        double before = 0;
        for (const Value& cell : cells.elements) {
            ASSERT_NE(cell.dictionary(), nullptr);
            const double level = numberIn(cell.dictionary()->at("RxLev"));
            expect(level <= before, "neighbours by their level");
            before = level;
            expect(cell.dictionary()->at("ARFCN") != Value(channel), "serving cell among the neighbours");
        }
    }

    void seeChannel(const Dictionary& channel)
    {
        const double power = numberIn(channel.at("Tx Power Level"));
        expect(power >= 5 && power <= 19, "power level");
        expect(numberIn(channel.at("RxQual")) <= 7, "RXQUAL");
        expect(numberIn(channel.at("Timing Advance")) <= 3, "timing advance in a town");
        expect(channel.at("Hopping").dictionary()->at("Frequencies").array()->elements.size() == 4,
               "frequencies, without their heading");
    }

    void expect(bool holds, const std::string& fault)
    {
        if (!holds && faults.size() < 20)
            faults.push_back(fmt::format("at {:.2f} s: {}", now, fault));
    }

    RecordingLog log;
    ScriptedPlatform platform;
    GSMLogGenerator generator{platform};
    State state;
    double now = 0;
    double last = 0;
    int messages = 0;
    std::vector<std::string> faults;
    std::map<std::vector<std::string>, int> layouts;
    std::string channel;
    std::set<std::string> channels;
    std::set<double> levels;
    std::size_t fewest = 99;
    std::size_t most = 0;
};

} // namespace

TEST_P(IfxHandsetLife, ShowsMeasurementsThatHangTogether)
{
    EXPECT_EQ(faults, std::vector<std::string>());
    EXPECT_GE(channels.size(), 5U) << "changes cells";
    EXPECT_GE(levels.size(), 20U);
    EXPECT_GT(most, fewest) << "neighbours come and go";
    for (const std::string& line : log.take())
        EXPECT_EQ(line.substr(0, 3), "<4>") << line;
}

TEST_P(IfxHandsetLife, HasSectionsThatComeAndGo)
{
    const auto count = [this](std::vector<std::string> names) { return layouts[names]; };
    EXPECT_EQ(count({"Radio Resource"}), 5) << "before it has found a cell";
    EXPECT_GT(count({"Serving Cell", "Neighbor Cells", "Radio Resource"}), 50);
    EXPECT_GT(count({"Serving Cell", "Neighbor Cells", "Radio Resource", "UMTS Cells"}), 100);
    EXPECT_GT(count({"Serving Cell", "Neighbor Cells", "Radio Resource", "Dedicated Channel"}), 100);
    EXPECT_GT(count({"Serving Cell", "Neighbor Cells", "Radio Resource", "Packet Transfer"}), 100);
    EXPECT_EQ(layouts.size(), 5U);
}

TEST(IfxHandset, IsTheSameForTheSameSeed)
{
    const auto life = [](std::uint64_t seed) {
        std::string bytes;
        watch("IFX", seed, 10min, [&bytes](const SeenMessage& message) {
            bytes.append(reinterpret_cast<const char*>(message.bytes().data()), message.size());
        });
        return bytes;
    };
    const std::string one = life(1);
    EXPECT_GT(one.size(), 500'000U);
    EXPECT_TRUE(one == life(1));
    EXPECT_FALSE(one == life(2));
}

INSTANTIATE_TEST_SUITE_P(Seeds, IfxHandsetLife, testing::Values(1, 2, 123456789));

} // namespace pelorus::test
