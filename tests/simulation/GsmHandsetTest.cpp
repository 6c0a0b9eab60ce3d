#include "tests/simulation/GsmWitness.h"

#include <gmock/gmock.h>

namespace pelorus::test {

namespace {

using namespace std::chrono_literals;

/// An hour of a GSM/UMTS handset's life, every message looked at.
class GsmHandsetLife : public testing::TestWithParam<std::uint64_t> {
protected:
    GsmHandsetLife()
    {
        watch("Osprey GSM", GetParam(), 1h, [this](const SeenMessage& message) { witness.see(message); });
    }

    GsmWitness witness;
};

} // namespace

TEST_P(GsmHandsetLife, ShowsMeasurementsThatHangTogether)
{
    EXPECT_EQ(witness.faults, std::vector<std::string>());
    EXPECT_GT(witness.highestRscp - witness.lowestRscp, 25) << "the handset moves";
    EXPECT_GT(witness.missingMeasurements, 10);
}

TEST_P(GsmHandsetLife, KeepsToCellsThatItHearsWell)
{
    int good = 0;
    int all = 0;
    for (const auto& [ecio, count] : witness.ratios) {
        all += count;
        good += ecio >= -16 && ecio <= -3 ? count : 0;
    }
    EXPECT_GT(good, 0.97 * all);
    EXPECT_GE(witness.ratios.size(), 10U) << "the Ec/Io moves";
}

TEST_P(GsmHandsetLife, RegistersInOrder)
{
    witness.registration.expectOnly(0, {{0, {5}}, {5, {2}}, {2, {1}}});
    EXPECT_TRUE(witness.registration.has(2, 1));
    EXPECT_EQ(witness.serviceTypes, (std::vector<int>{4, 1})) << "limited, then circuit-switched only";
    witness.mm.expectOnly(
        0, {{0, {19}}, {19, {19, 13, 14}}, {13, {3}}, {3, {9}}, {9, {19}}, {14, {5}}, {5, {6}}, {6, {9}}});
    witness.gmm.expectOnly(0, {{0, {1}}, {1, {1, 2}}, {2, {3}}, {3, {3, 5, 6}}, {5, {3}}, {6, {3}}});
}

TEST_P(GsmHandsetLife, ChangesItsRadioStatesInOrder)
{
    witness.rr.expectOnly(0, {{0, {1, 13, 14, 21}},
                              {1, {4}},
                              {2, {0}},
                              {3, {8}},
                              {4, {3}},
                              {5, {6, 7, 18}},
                              {6, {5}},
                              {7, {9}},
                              {8, {5}},
                              {9, {6, 11}},
                              {11, {5}},
                              {13, {9}},
                              {14, {5}},
                              {18, {2}},
                              {21, {5}}});
    witness.rrc.expectOnly(0, {{0, {1}}, {1, {2, 3}}, {2, {0, 4}}, {3, {0, 2}}, {4, {2}}});
    EXPECT_TRUE(witness.rr.has(18, 2)) << "to UMTS";
    EXPECT_TRUE(witness.rr.has(0, 13) || witness.rr.has(0, 14) || witness.rr.has(0, 21)) << "to GSM";
}

TEST_P(GsmHandsetLife, ChangesCellsThatItHasMeasuredBefore)
{
    EXPECT_EQ(witness.activeSetSizes, (std::set<std::size_t>{1, 2, 3}));
    EXPECT_GE(witness.servingScramblingCodes.size(), 3U);
    EXPECT_GE(witness.servingArfcns.size(), 3U);
    EXPECT_EQ(witness.locationAreas, (std::set<int>{4301, 4302}));
    EXPECT_EQ(witness.routingAreas, (std::set<int>{1, 2}));
    EXPECT_EQ(witness.unannounced, 0);
}

INSTANTIATE_TEST_SUITE_P(Seeds, GsmHandsetLife, testing::Values(1, 2, 3, 123456789));

} // namespace pelorus::test
