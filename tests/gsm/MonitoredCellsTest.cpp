#include "tests/gsm/IndexFixture.h"
#include "tests/gsm/Packets.h"

#include <gmock/gmock.h>

namespace pelorus::test {
namespace {

using testing::ElementsAre;

struct Reader {
    const char* section;
    const char* banner;
    bool empties; // its list, before it looks at the cells

    friend std::ostream& operator<<(std::ostream& out, const Reader& reader) { return out << reader.section; }
};

/// The sections that read the cell monitor's list, where there is none worth the name.
class MonitorReader : public testing::TestWithParam<Reader> {
protected:
    void expectShown(const NamedSection& section) const
    {
        EXPECT_EQ(section.shown(), GetParam().empties ? "" : NamedSection::shownBefore(GetParam().section));
    }
    std::string banner() const { return "<4>" + std::string(GetParam().banner); }
};

TEST_P(MonitorReader, LogsTwoLinesForAPayloadThatCannotBeRead)
{
    NamedSection section(GetParam().section);
    section.receive(0xFF0001, PacketBuilder(40).u8(0, 0xFF));
    expectShown(section);
    EXPECT_THAT(section.log.take(), ElementsAre(banner(), "<3>Cell Info Array data could not be constructed",
                                                "<3>Failed to get Cell Array\n"));
}

TEST_P(MonitorReader, LogsTwoLinesForAPacketWithoutPayload)
{
    for (const std::size_t length : {11U, 12U, 13U}) {
        NamedSection section(GetParam().section);
        section.receive(0xFF0001, PacketBuilder(length).u8(0, 0xFF));
        expectShown(section);
        EXPECT_THAT(section.log.take(),
                    ElementsAre(banner(), "<3>Cell Info Array data could not be constructed",
                                "<3>Failed to get Cell Array\n"));
    }
}

TEST_P(MonitorReader, LogsOneLineForAPayloadThatIsNoArray)
{
    NamedSection section(GetParam().section);
    section.receive(0xFF0001, internalPacket(gsmServingCell()));
    expectShown(section);
    EXPECT_THAT(section.log.take(), ElementsAre(banner(), "<3>Failed to get Cell Array\n"));
}

TEST_P(MonitorReader, IsSilentAboutAnEmptyList)
{
    NamedSection section(GetParam().section);
    section.receive(0xFF0001, monitoredCells({}));
    expectShown(section);
    EXPECT_THAT(section.log.take(), ElementsAre(banner()));
}

TEST_P(MonitorReader, PassesOverWhatIsNoCellOfItsOwn)
{
    NamedSection section(GetParam().section);
    section.receive(0xFF0001,
                    monitoredCells({"text", 7, makeArray({gsmServingCell()}), makeDictionary(),
                                    cell("LTE", "Serving", {{"CellMonitorCellId", 1}}),
                                    cell("gsm", "Serving", {{"CellMonitorCellId", 1}}),
                                    cell("GSM ", "Neighbor", {{"CellMonitorARFCN", 1}}),
                                    cell("UMTS", "serving", {{"CellMonitorCellId", 1}}),
                                    makeDictionary({{"CellMonitorCellType", "CellMonitorCellTypeServing"}}),
                                    makeDictionary({{"CellMonitorCellRadioAccessTechnology",
                                                     "CellMonitorRadioAccessTechnologyUMTS"}})}));
    expectShown(section);
    EXPECT_THAT(section.log.take(), ElementsAre(banner()));
}

INSTANTIATE_TEST_SUITE_P(EverySection, MonitorReader,
                         testing::Values(Reader{"GSM Serving Cell", "GSMServingCell", false},
                                         Reader{"Neighboring Cells", "NeighboringCells", true},
                                         Reader{"Serving PLMN", "Serving PLMN", false},
                                         Reader{"UMTS Set", "UMTSSet", true},
                                         Reader{"UMTS RR Info", "UMTSRRInfo", false}));

} // namespace
} // namespace pelorus::test
