#include "LogGenerator/Osprey/LTE/ServingCellMeasurement.h"
#include "tests/support/SectionFixture.h"

#include <gmock/gmock.h>

namespace pelorus::test {
namespace {

using testing::ElementsAre;

// Every bit field of the bit string that starts at byte 19, with values that differ from field to field.
PacketBuilder fullPacket()
{
    return PacketBuilder(33)
        .u8(13, 4)
        .u16(17, 1850)
        .bits(19, 0, 9, 301)
        .bits(19, 9, 4, 6)
        .bits(19, 13, 3, 7)
        .bits(19, 16, 9, 190)
        .bits(19, 25, 9, 188)
        .bits(19, 34, 7, 78)
        .bits(19, 41, 7, 75)
        .bits(19, 48, 9, 141)
        .bits(19, 57, 6, 8)
        .bits(19, 63, 7, 53)
        .bits(19, 70, 6, 53)
        .bits(19, 76, 4, 15)
        .bits(19, 80, 7, 59)
        .bits(19, 87, 6, 2)
        .bits(19, 93, 6, 31)
        .bits(19, 99, 6, 4)
        .bits(19, 105, 1, 1)
        .bits(19, 106, 4, 9);
}

TEST(ServingCellMeasurement, ShowsEveryRowInTableOrder)
{
    SectionFixture<ServingCellMeasurement> section(makeDictionary());
    section.receive(0xB17F, fullPacket());
    EXPECT_EQ(section.shown(), "Version: 4\n"
                               "E-ARFCN: 1850\n"
                               "Physical Cell ID: 301\n"
                               "Serving Layer Priority: 6\n"
                               "Measured RSRP: -92.50 dBm\n"
                               "Average RSRP: -93.00 dBm\n"
                               "Measured RSRQ: -10.50 dB\n"
                               "Average RSRQ: -11.25 dB\n"
                               "Measured RSSI: -69.50 dBm\n"
                               "Qrxlevmin: -124 dBm\n"
                               "P_Max: 23 dBm\n"
                               "Max UE Tx Power: 23 dBm\n"
                               "Srxlev: 29 dBm\n"
                               "Num of Consecutive DRX Cycles of S < 0: 2\n"
                               "S Intra Search: 62 dB\n"
                               "S Non Intra Search: 8 dBm\n"
                               "Measurement Rules Updated: True\n"
                               "Measurement Rules: 9\n");
    EXPECT_THAT(section.logged(), ElementsAre("<4>Serving Cell Measurements"));
}

TEST(ServingCellMeasurement, SubscribesToTheIdleModeMeasurement)
{
    SectionFixture<ServingCellMeasurement> section(makeDictionary());
    EXPECT_EQ(section.section.getSectionName(), "Serving Cell Measurements");
    EXPECT_THAT(section.section.getLogCodeArray(), ElementsAre(0xB17F));
}

struct Extreme {
    unsigned first, width, value;
    const char* row;
    const char* text;
};

class ServingCellMeasurementField : public testing::TestWithParam<Extreme> {};

TEST_P(ServingCellMeasurementField, ShowsItsExtremes)
{
    SectionFixture<ServingCellMeasurement> section(makeDictionary());
    const auto& [first, width, value, row, text] = GetParam();
    section.receive(0xB17F, PacketBuilder(33).bits(19, first, width, value));
    EXPECT_EQ(section.row(row), text);
}

INSTANTIATE_TEST_SUITE_P(
    BothEnds, ServingCellMeasurementField,
    testing::Values(
        Extreme{0, 9, 0, "Physical Cell ID", "0"}, Extreme{0, 9, 511, "Physical Cell ID", "511"},
        Extreme{9, 4, 15, "Serving Layer Priority", "15"}, Extreme{16, 9, 0, "Measured RSRP", "-140.00 dBm"},
        Extreme{16, 9, 511, "Measured RSRP", "-12.25 dBm"}, Extreme{25, 9, 0, "Average RSRP", "-140.00 dBm"},
        Extreme{25, 9, 511, "Average RSRP", "-12.25 dBm"}, Extreme{34, 7, 0, "Measured RSRQ", "-30.00 dB"},
        Extreme{34, 7, 127, "Measured RSRQ", "1.75 dB"}, Extreme{41, 7, 0, "Average RSRQ", "-30.00 dB"},
        Extreme{41, 7, 127, "Average RSRQ", "1.75 dB"}, Extreme{48, 9, 0, "Measured RSSI", "-140.00 dBm"},
        Extreme{48, 9, 511, "Measured RSSI", "115.50 dBm"}, Extreme{57, 6, 0, "Qrxlevmin", "-140 dBm"},
        Extreme{57, 6, 63, "Qrxlevmin", "-14 dBm"}, Extreme{63, 7, 64, "P_Max", "Not Present"},
        Extreme{63, 7, 0, "P_Max", "-30 dBm"}, Extreme{63, 7, 65, "P_Max", "35 dBm"},
        Extreme{63, 7, 127, "P_Max", "97 dBm"}, Extreme{70, 6, 0, "Max UE Tx Power", "-30 dBm"},
        Extreme{70, 6, 63, "Max UE Tx Power", "33 dBm"}, // never "Not Present": the field is too narrow
        Extreme{80, 7, 0, "Srxlev", "-30 dBm"}, Extreme{80, 7, 127, "Srxlev", "97 dBm"},
        Extreme{87, 6, 63, "Num of Consecutive DRX Cycles of S < 0", "63"},
        Extreme{93, 6, 32, "S Intra Search", "Not Present"}, Extreme{93, 6, 31, "S Intra Search", "62 dB"},
        Extreme{93, 6, 33, "S Intra Search", "66 dB"},
        Extreme{99, 6, 32, "S Non Intra Search", "Not Present"},
        Extreme{99, 6, 31, "S Non Intra Search", "62 dBm"},
        Extreme{105, 1, 0, "Measurement Rules Updated", "False"},
        Extreme{105, 1, 1, "Measurement Rules Updated", "True"},
        Extreme{106, 4, 15, "Measurement Rules", "15"}));

TEST(ServingCellMeasurement, KeepsItsRowsWhenThePacketIsOneByteShort)
{
    SectionFixture<ServingCellMeasurement> section(makeDictionary());
    section.receive(0xB17F, fullPacket());
    const std::string before = section.shown();
    section.logged();
    section.receive(0xB17F, PacketBuilder(33).u8(13, 9).length(32));
    EXPECT_EQ(section.shown(), before);
    EXPECT_THAT(section.logged(), ElementsAre("<4>Serving Cell Measurements"));
}

TEST(ServingCellMeasurement, LogsAForeignCodeAndChangesNothing)
{
    SectionFixture<ServingCellMeasurement> section(makeDictionary());
    section.receive(0xB180, fullPacket());
    EXPECT_EQ(section.shown(), "");
    EXPECT_THAT(section.logged(),
                ElementsAre("<4>Serving Cell Measurements", "<3>Received an unknown log message: 45440"));
}

} // namespace
} // namespace pelorus::test
