#pragma once

#include "tests/simulation/SimulatedLife.h"
#include "tests/simulation/StateHistory.h"

#include <string>
#include <vector>

namespace pelorus::test {

/// Watches the log of a GSM/UMTS handset as a suspicious engineer would, and notes what cannot be.
class GsmWitness {
public:
    void see(const SeenMessage& message);

    std::vector<std::string> faults;
    StateHistory registration, mm, gmm, rr, rrc;
    std::set<std::size_t> activeSetSizes;
    std::set<int> servingScramblingCodes; // of 0x417A in idle mode
    std::set<int> servingArfcns;
    std::set<int> locationAreas;
    std::set<int> routingAreas;
    std::vector<int> serviceTypes; // before the full one
    int unannounced = 0;           // cells that joined or served without having been measured
    int missingMeasurements = 0;
    std::map<int, int> ratios; // Ec/Io of active cells, and how often
    int lowestRscp = 0;
    int highestRscp = -200;

private:
    void seeCellSet(const SeenMessage& message);
    void seeRankedCells(const SeenMessage& message);
    void seeTransmitPower(const SeenMessage& message);
    void seeHarq(const SeenMessage& message);
    void seeBlockErrors(const SeenMessage& message);
    void seeGsmMeasurement(const SeenMessage& message);
    void seeServingNetwork(const SeenMessage& message);
    void seeCells(const SeenMessage& message);
    void expect(bool holds, const std::string& fault);
    void expectGrowing(std::map<int, std::int64_t>& counters, int key, std::int64_t value);

    double now = 0;
    int rrcState = -1;
    int rrState = -1;
    std::set<int> activeSet;
    std::set<int> monitored;
    std::set<int> gsmNeighbours;
    std::map<int, std::int64_t> harqCounters;
    std::map<int, std::int64_t> blockCounters;
};

} // namespace pelorus::test
