#include "telephonyd/simulation/LteHandset.h"
#include "tests/telephonyd/LteWitness.h"

#include <gmock/gmock.h>

namespace pelorus::test {

namespace {

using namespace std::chrono_literals;

/// An hour of an LTE handset's life, every message looked at.
class LteHandsetLife : public testing::TestWithParam<std::uint64_t> {
protected:
    LteHandsetLife()
    {
        LteHandset handset(GetParam());
        MessageBatch batch(HandsetTime{} + std::chrono::hours(24 * 365 * 50));
        while (batch.time() < 1h) {
            batch.clear();
            handset.step(batch);
            for (std::size_t message = 0; message < batch.size(); ++message)
                witness.see(PacketReader(batch[message].bytes));
        }
    }

    LteWitness witness;
};

} // namespace

TEST_P(LteHandsetLife, LogsEveryCode)
{
    using testing::UnorderedElementsAre;
    std::set<int> codes;
    for (const auto& [code, count] : witness.counts)
        codes.insert(code);
    EXPECT_THAT(codes, UnorderedElementsAre(0xB0C1, 0xB0C2, 0xB179, 0xB17F, 0xB180, 0xB186, 0xFF0000,
                                            0xFF0001, 0xFF0002));
    EXPECT_GE(witness.counts[0xFF0000], 2);   // at the start, and again half an hour later
    EXPECT_LE(witness.counts[0xFF0000], 3);   // but rarely
    EXPECT_GE(witness.counts[0xFF0001], 110); // at least every half minute
    EXPECT_GE(witness.counts[0xB17F], 1000);
    EXPECT_GE(witness.counts[0xB179], 2000);
}

TEST_P(LteHandsetLife, ChangesCellsIdleAndConnected)
{
    EXPECT_GE(witness.reselections, 5);
    EXPECT_GE(witness.handovers, 3);
    EXPECT_EQ(witness.unannounced, 0) << "cells that served without having been measured as neighbours";
    EXPECT_EQ(witness.trackingAreas, (std::set<int>{4301, 4302}));
    EXPECT_EQ(witness.servingEarfcns, (std::set<int>{1850, 3100}));
}

TEST_P(LteHandsetLife, ShowsMeasurementsThatHangTogether)
{
    EXPECT_EQ(witness.faults, std::vector<std::string>());
    EXPECT_GT(witness.highestRsrp - witness.lowestRsrp, 20) << "the handset moves";
}

TEST_P(LteHandsetLife, MeetsCandidatesOfSeveralTechnologies)
{
    EXPECT_THAT(witness.candidateTechnologies, testing::IsSupersetOf({0, 1, 2, 3}));
    EXPECT_THAT(witness.contextCounts, testing::UnorderedElementsAre(1U, 2U));
    EXPECT_THAT(witness.monitoredTechnologies,
                testing::UnorderedElementsAre("CellMonitorRadioAccessTechnologyLTE",
                                              "CellMonitorRadioAccessTechnologyUMTS",
                                              "CellMonitorRadioAccessTechnologyGSM"));
}

INSTANTIATE_TEST_SUITE_P(Seeds, LteHandsetLife, testing::Values(1, 2, 3, 123456789));

} // namespace pelorus::test
