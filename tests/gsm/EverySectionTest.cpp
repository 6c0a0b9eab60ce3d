#include "tests/gsm/IndexFixture.h"
#include "tests/gsm/Packets.h"
#include "tests/support/HostilePackets.h"

#include <gmock/gmock.h>

namespace pelorus::test {
namespace {

using testing::ElementsAre;

struct Frame {
    const char* section;
    const char* banner;
    bool logsUnknownCodes;

    friend std::ostream& operator<<(std::ostream& out, const Frame& frame) { return out << frame.section; }
};

class FrameOf : public testing::TestWithParam<Frame> {};

TEST_P(FrameOf, ACodeThatNobodySentIsAnnouncedAndChangesNothing)
{
    const auto& [name, banner, logsUnknownCodes] = GetParam();
    NamedSection section(name);
    section.receive(0x1234, PacketBuilder(400));
    EXPECT_EQ(section.shown(), NamedSection::shownBefore(name));
    if (logsUnknownCodes)
        EXPECT_THAT(section.log.take(),
                    ElementsAre("<4>" + std::string(banner), "<3>Received an unknown log message: 4660"));
    else
        EXPECT_THAT(section.log.take(), ElementsAre("<4>" + std::string(banner)));
}

INSTANTIATE_TEST_SUITE_P(
    EverySection, FrameOf,
    testing::Values(
        Frame{"Active Set", "ActiveSet", true},
        Frame{"Coding Scheme", "CellChangeCounters", false}, // its neighbour's banner
        Frame{"GPRS Information", "GPRSInformation", true}, Frame{"GSM Serving Cell", "GSMServingCell", true},
        Frame{"Mobile Allocation", "MobileAllocation", true},
        Frame{"Neighboring Cells", "NeighboringCells", true},
        Frame{"PDP Context Info", "PDPContextList", false}, Frame{"Process PS", "ProcessPS", true},
        Frame{"UMTS RR Measurement", "UMTSRRMeasurement", false},
        Frame{"Cell Change Counters", "CellChangeCounters", false},
        Frame{"Detected Set", "DetectedSet", true}, Frame{"GSM Set", "GSMSet", true},
        Frame{"Non-Ranked GSM Set", "NonRankedGSMSet", false},
        Frame{"Process CO", "ProcessCS", true}, // the CS section's banner
        Frame{"Serving PLMN", "Serving PLMN", true}, Frame{"UMTS Set", "UMTSSet", true},
        Frame{"Equivalent PLMN List", "Equivalent PLMN List", true}, Frame{"GSM RR Info", "GSMRRInfo", true},
        Frame{"Monitored Set", "MonitoredSet", true}, Frame{"Non-Ranked UMTS Set", "NonRankedUMTSSet", false},
        Frame{"Process CS", "ProcessCS", true}, Frame{"UMTS RR Info", "UMTSRRInfo", true},
        Frame{"BLER", "BLER", true}, Frame{"Virtual Active Set", "VirtualActiveSet", true},
        Frame{"SIM Info", "SimInfo", false}, Frame{"HSDPA Info", "HSDPA Info", false}));

struct Minimum {
    const char* section;
    LogCode code;
    std::size_t length;

    friend std::ostream& operator<<(std::ostream& out, const Minimum& minimum)
    {
        return out << minimum.section << ", " << std::hex << minimum.code;
    }
};

class MinimumLengthOf : public testing::TestWithParam<Minimum> {};

TEST_P(MinimumLengthOf, IsWhereDecodingBegins)
{
    const auto& [name, code, length] = GetParam();
    NamedSection section(name);
    const std::string before = NamedSection::shownBefore(name);
    section.receive(code, PacketBuilder(length - 1));
    EXPECT_EQ(section.shown(), before);
    EXPECT_EQ(section.log.take().size(), 1U); // the banner, and no word about the length
    section.receive(code, PacketBuilder(length));
    EXPECT_NE(section.shown(), before);
    EXPECT_EQ(section.log.take().size(), 1U);

    NamedSection other(name);
    other.receive(code, PacketBuilder(length + 1));
    EXPECT_EQ(other.shown(), section.shown());
}

// 0x51FF changes no row by itself; the tests of the neighbouring cells have it.
INSTANTIATE_TEST_SUITE_P(
    EverySection, MinimumLengthOf,
    testing::Values(Minimum{"Process CO", 0x7131, 16}, Minimum{"Process CO", 0x7132, 16},
                    Minimum{"Process CS", 0x7131, 16}, Minimum{"Process CS", 0x7132, 16},
                    Minimum{"Process PS", 0x7130, 16}, Minimum{"Process PS", 0x7132, 16},
                    Minimum{"Serving PLMN", 0x7135, 32}, Minimum{"Serving PLMN", 0x7132, 16},
                    Minimum{"Equivalent PLMN List", 0x7150, 17}, Minimum{"Active Set", 0x417A, 16},
                    Minimum{"Detected Set", 0x417A, 16}, Minimum{"Monitored Set", 0x417A, 16},
                    Minimum{"Virtual Active Set", 0x417A, 16}, Minimum{"UMTS Set", 0x4005, 15},
                    Minimum{"GSM Set", 0x4005, 15}, Minimum{"GSM Serving Cell", 0x5134, 26},
                    Minimum{"GSM Serving Cell", 0x5137, 29}, Minimum{"GSM Serving Cell", 0x5076, 17},
                    Minimum{"Neighboring Cells", 0x5137, 29}, Minimum{"GSM RR Info", 0x512C, 17},
                    Minimum{"GSM RR Info", 0x5137, 29}, Minimum{"GSM RR Info", 0x5072, 20},
                    Minimum{"GSM RR Info", 0x51F6, 24}, Minimum{"GPRS Information", 0x51F5, 18},
                    Minimum{"GPRS Information", 0x7135, 32}, Minimum{"GPRS Information", 0x51F6, 24},
                    Minimum{"GPRS Information", 0x51FB, 34}, Minimum{"GPRS Information", 0x51FD, 35},
                    Minimum{"GPRS Information", 0x51F4, 15}, Minimum{"GPRS Information", 0x5137, 29},
                    Minimum{"Mobile Allocation", 0x51F8, 15}, Minimum{"UMTS RR Info", 0x4125, 14},
                    Minimum{"UMTS RR Info", 0x4031, 16}, Minimum{"UMTS RR Info", 0x4127, 29},
                    Minimum{"UMTS RR Info", 0x4157, 19}, Minimum{"HSDPA Info", 0x4221, 18},
                    Minimum{"BLER", 0x4116, 16}));

// Whatever stands in a packet, no section reads beyond it, and only the SIM files end the program.
TEST(EverySection, SurvivesCutAndRandomPackets)
{
    OSP_GSMClassIndex index;
    RecordingLog log;
    const auto receive = [&](LogCode code) {
        return [&index, code](const LogPacket& packet) {
            for (Base* section : *index.getSubscribers(code))
                try {
                    section->updateWithData(packet, code);
                } catch (const LogCode_0xFF0000::UnknownDataException&) {
                    EXPECT_EQ(section->getSectionName(), "SIM Info");
                }
        };
    };
    std::vector<Value> entries; // sections only refer to theirs
    for (const std::string& text : index.getAllLogCodes()) {
        const auto code = static_cast<LogCode>(std::stoul(text));
        for (Base* section : *index.getSubscribers(code)) {
            entries.push_back(showsAList(section->getSectionName()) ? Value(makeArray())
                                                                    : Value(makeDictionary()));
            section->updateSectionRef(entries.back());
        }
        forEachPrefix(fullPacket(code).bytes(), receive(code));
        forRandomPackets(300, 5000, receive(code));
        forRandomPackets(300, 60, receive(code));
        log.take();
    }
}

TEST(EverySection, DecodesWithoutADisplay)
{
    OSP_GSMClassIndex index;
    for (const std::string& text : index.getAllLogCodes()) {
        const auto code = static_cast<LogCode>(std::stoul(text));
        const PacketBuilder packet = fullPacket(code);
        for (Base* section : *index.getSubscribers(code))
            EXPECT_NO_THROW(section->updateWithData(LogPacket(packet.bytes()), code));
    }
}

} // namespace
} // namespace pelorus::test
