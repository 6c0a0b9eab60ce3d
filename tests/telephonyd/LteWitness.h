#pragma once

#include "tests/telephonyd/PacketReader.h"

#include <map>
#include <set>
#include <string>
#include <vector>

namespace pelorus::test {

/// Watches the log of an LTE handset as a suspicious engineer would, and notes what cannot be.
class LteWitness {
public:
    void see(PacketReader packet);

    std::map<int, int> counts; // of messages, by code
    std::vector<std::string> faults;
    int reselections = 0;
    int handovers = 0;
    int unannounced = 0;
    std::set<int> trackingAreas;
    std::set<int> servingEarfcns;
    std::set<int> candidateTechnologies;
    std::set<std::size_t> contextCounts;
    std::set<std::string> monitoredTechnologies;
    double lowestRsrp = 0;
    double highestRsrp = -140;

private:
    void seeHeader(PacketReader packet);
    void seeServingCell(PacketReader packet);
    void seeIdleMeasurement(PacketReader packet);
    void seeNeighbours(PacketReader packet);
    void seeConnectedMeasurement(PacketReader packet);
    void seeCandidates(PacketReader packet);
    void seeCandidate(PacketReader record);
    void seeSimFiles(PacketReader packet);
    void seeCells(PacketReader packet);
    void seeContexts(PacketReader packet);
    void expect(bool holds, const std::string& fault);
    void expectLevels(const std::string& where, double rsrp, double rsrq);

    int servingCell = -1;
    int servingEarfcn = -1;
    bool connected = false;
    std::map<int, std::set<int>> neighbours; // as last measured, by EARFCN
    int seen = 0;
};

} // namespace pelorus::test
