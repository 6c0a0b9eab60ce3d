#include "telephonyd/simulation/UtranTraffic.h"

#include <algorithm>

namespace pelorus {

namespace {

constexpr double kNeededRatio = 4.0;    // dB, where one block in a hundred is lost
constexpr double kRatioPerDecade = 3.0; // dB
constexpr double kWindow = 0.1;         // share of a new report in the block error rate
constexpr double kLowestRatio = -11.0;
constexpr double kHighestRatio = 20.0;
constexpr double kOtherChannels = -4.0; // dB of a composite channel that carries less

} // namespace

void UtranTraffic::begin(bool isData)
{
    // Speech has three classes of bits and its signalling; data has its own.
    static constexpr std::uint8_t kSpeech[] = {1, 2, 3, 31};
    static constexpr std::uint8_t kData[] = {24, 31};
    using Identities = std::span<const std::uint8_t>;
    const Identities identities = isData ? Identities(kData) : Identities(kSpeech);
    channelCount = identities.size();
    for (std::size_t i = 0; i < channelCount; ++i)
        channels[i] = {identities[i], 0.005};
    compositeCount = isData ? 2 : 1;
    composites = {{{1, 4, {}}, {2, 5, {}}}};
}

void UtranTraffic::advance(double interferenceRatio, Random& random)
{
    for (std::size_t i = 0; i < compositeCount; ++i)
        for (double& ratio : composites[i].ratios) {
            const double power = i == 0 ? 0.0 : kOtherChannels;
            ratio =
                std::clamp(interferenceRatio + power + 1.5 * random.normal(), kLowestRatio, kHighestRatio);
        }
    const double exponent = -2.0 - (interferenceRatio - kNeededRatio) / kRatioPerDecade;
    const double rate = std::clamp(std::pow(10.0, exponent), 0.0001, 0.5);
    for (std::size_t i = 0; i < channelCount; ++i) {
        double& known = channels[i].errorRate;
        known += kWindow * (rate * random.between(0.3, 1.7) - known);
    }
}

} // namespace pelorus
