#pragma once

#include "telephonyd/simulation/CdmaNetwork.h"
#include "telephonyd/simulation/RadioField.h"

namespace pelorus {

/// One CDMA channel as the handset receives it.
struct CdmaCarrier {
    using PerSector = std::array<double, kCdmaSectorCount>;

    PerSector strengths{};          // Ec/Io of each pilot in dB, just now
    PerSector averages{};           // likewise, filtered over time
    PerSector ratios{};             // C/I of each sector in dB, just now; of EV-DO
    std::array<double, 2> levels{}; // all of the channel in dBm, in each receive chain

    std::size_t best() const;
};

/// What a CDMA2000 handset receives. All sectors share the channels, and are each other's interference.
class CdmaRadio {
public:
    CdmaRadio(Point where, Random& random);

    void advance(const Journey& journey, double seconds, Random& random);

    /// 1x: pilots are a fifth of what a sector can send, and stand out the less the busier it is.
    const CdmaCarrier& cdma() const { return cdmaCarrier; }
    /// EV-DO: pilots are bursts of full power, at the same time from all sectors.
    const CdmaCarrier& evdo() const { return evdoCarrier; }

private:
    void measure();
    void average(double gain);

    RadioField field;
    std::vector<Drift> loads;
    Drift diversity; // between the receive chains
    CdmaCarrier cdmaCarrier;
    CdmaCarrier evdoCarrier;
};

} // namespace pelorus
