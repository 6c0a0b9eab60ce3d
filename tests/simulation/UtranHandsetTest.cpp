#include "platform/PropertyList.h"
#include "tests/simulation/SimulatedLife.h"
#include "tests/simulation/StateHistory.h"

#include <fmt/format.h>
#include <gmock/gmock.h>

namespace pelorus::test {

namespace {

using namespace std::chrono_literals;

/// An hour of a UTRAN2 handset's life, every message looked at.
class UtranHandsetLife : public testing::TestWithParam<std::uint64_t> {
protected:
    UtranHandsetLife()
    {
        watch("Osprey UTRAN2", GetParam(), 1h, [this](const SeenMessage& message) { see(message); });
    }

    void see(const SeenMessage& message)
    {
        now = message.seconds();
        switch (message.code()) {
        case 0xD0E0:
            expect(message.size() == 15 && message.u8(13) == 1, "D0E0");
            mode = message.u8(14);
            return modes.enter(mode);
        case 0xD0E2:
            return seeServingCell(message);
        case 0xD00A:
            return seeNeighbours(message);
        case 0xD00E:
            return seeGsmNeighbours(message);
        case 0xD00C:
            return seeTransportChannels(message);
        case 0xFF0001:
            return seeCells(message);
        default:
            return;
        }
    }

    void seeServingCell(const SeenMessage& message)
    {
        expect(message.size() == 26, "length of D0E2");
        expect(message.u16(17) == message.u16(19), "one frequency both ways");
        expect(message.u16(17) >= 10050 && message.u16(17) <= 10125, "UARFCN");
        expect(message.u8(25) == 0, "emergency calls only");
        servingCells.insert(message.u32(21));
    }

    void seeNeighbours(const SeenMessage& message)
    {
        const int count = message.u8(16) >> 1;
        expect(message.size() == static_cast<std::size_t>(168 + 16 * count), "length of D00A");
        int active = 0;
        int last = 255;
        std::set<int> cells;
        for (int cell = 0; cell < count; ++cell) {
            const std::int64_t word = message.u32(static_cast<std::size_t>(168 + 16 * cell));
            expect((word & 0x3FFF) >= 10050 && (word & 0x3FFF) <= 10125, "UARFCN of a neighbour");
            expect(cells.insert(static_cast<int>(word >> 14 & 0x7F)).second, "the same neighbour twice");
            const int level = static_cast<int>(word >> 21 & 0xFF);
            expect(level <= 91 && level <= last, "RSCP");
            last = level;
            const auto set = word >> 29 & 3;
            expect(set <= 2 && (set == 1) <= (word >> 31 == 1), "set of a neighbour");
            active += set == 0;
        }
        expect(active == (mode == 3 ? 1 : 0), "active set");
        mostNeighbours = std::max(mostNeighbours, count);
        fewestNeighbours = std::min(fewestNeighbours, count);
        known = cells;
    }

    void seeGsmNeighbours(const SeenMessage& message)
    {
        const int count = message.u8(16);
        expect(message.size() == static_cast<std::size_t>(17 + 8 * count), "length of D00E");
        for (int cell = 0; cell < count; ++cell) {
            const auto entry = static_cast<std::size_t>(17 + 8 * cell);
            expect(message.u8(entry + 1) == 0x80, "BSIC valid in GSM 900");
            expect(message.u8(entry + 2) <= 7 && message.u8(entry + 3) <= 7, "BSIC");
            expect(message.u16(entry + 4) <= 124, "ARFCN");
            expect(message.s16(entry + 6) >= -110 && message.s16(entry + 6) <= -47, "RSSI");
        }
    }

    void seeTransportChannels(const SeenMessage& message)
    {
        const int channels = message.u16(14) >> 6 & 0x3F;
        const int composites = message.u16(14) >> 12;
        expect(mode == 3, "transport channels without CELL_DCH");
        expect(channels >= 2 && composites >= 1, "channels");
        const int start = 289 + 34 * channels;
        expect(message.size() == static_cast<std::size_t>(start + 8 * composites), "length of D00C");
        for (int channel = 0; channel < channels; ++channel)
            expect(message.u8(static_cast<std::size_t>(17 + 2 * channel + 1)) <= 63, "BLER");
        for (int channel = 0; channel < composites; ++channel) {
            const auto entry = static_cast<std::size_t>(start + 8 * channel);
            expect(message.u8(entry) == channel + 1 && message.u8(entry + 1) <= 6, "CCTrCH");
            for (std::size_t position = 2; position < 8; ++position) {
                expect(message.u8(entry + position) <= 63, "SIR");
                ratios.insert(message.u8(entry + position));
            }
        }
    }

    void seeCells(const SeenMessage& message)
    {
        const Value list = parsePropertyList(message.bytes().subspan(13));
        ASSERT_TRUE(list.array());
        int serving = 0;
        for (const Value& element : list.array()->elements) {
            ASSERT_TRUE(element.dictionary());
            const Dictionary& cell = *element.dictionary();
            if (*cell.at("CellMonitorCellType").string() != "CellMonitorCellTypeServing")
                continue;
            ++serving;
            expect(*cell.at("CellMonitorCellRadioAccessTechnology").string() ==
                       "CellMonitorRadioAccessTechnologyUTRAN2",
                   "technology");
            const auto scramblingCode = signed32(cell.find("CellMonitorSCN")).value_or(-1);
            expect(scramblingCode >= 0 && scramblingCode <= 127, "scrambling code");
            if (scramblingCode != servingCode && servingCode >= 0 && !known.contains(scramblingCode))
                ++unannounced;
            servingCode = scramblingCode;
            areas.insert(signed32(cell.find("CellMonitorLAC")).value_or(-1));
        }
        expect(serving == 1, "one serving cell");
    }

    void expect(bool holds, const std::string& fault)
    {
        if (!holds && faults.size() < 20)
            faults.push_back(fmt::format("at {:.2f} s: {}", now, fault));
    }

    double now = 0;
    int mode = -1;
    StateHistory modes;
    std::vector<std::string> faults;
    std::set<std::int64_t> servingCells;
    std::set<int> known;
    std::set<int> ratios;
    std::set<int> areas;
    int servingCode = -1;
    int unannounced = 0;
    int mostNeighbours = 0;
    int fewestNeighbours = 99;
};

} // namespace

TEST_P(UtranHandsetLife, ShowsMeasurementsThatHangTogether)
{
    EXPECT_EQ(faults, std::vector<std::string>());
    EXPECT_GT(mostNeighbours, fewestNeighbours) << "neighbours come and go";
    EXPECT_GT(ratios.size(), 20U) << "the SIR moves";
}

TEST_P(UtranHandsetLife, ChangesItsModesInOrder)
{
    modes.expectOnly(0, {{0, {1}}, {1, {2}}, {2, {0, 3, 4, 5}}, {3, {0, 2}}, {4, {2}}, {5, {2}}});
    for (const auto& [from, to] : {std::pair(0, 1), {2, 3}, {3, 0}, {3, 2}, {2, 4}, {2, 5}, {4, 2}})
        EXPECT_TRUE(modes.has(from, to)) << from << " to " << to;
}

TEST_P(UtranHandsetLife, ChangesCellsThatItHasMeasuredBefore)
{
    EXPECT_GE(servingCells.size(), 5U);
    EXPECT_EQ(unannounced, 0);
    EXPECT_EQ(areas, (std::set<int>{4301, 4302}));
}

INSTANTIATE_TEST_SUITE_P(Seeds, UtranHandsetLife, testing::Values(1, 2, 3, 123456789));

} // namespace pelorus::test
