#include "telephonyd/simulation/LteReselectionCandidates.h"

#include "LogGenerator/Osprey/LTE/LogCode_0xB186.h"

namespace pelorus {

namespace {

using Layout = LogCode_0xB186;
using Technology = ReselectionCandidate::Technology;

void writeCandidate(PacketWriter record, const ReselectionCandidate& candidate)
{
    using Fields = Layout::Candidate;
    record.put(Fields::priority, candidate.priority);
    record.put(Fields::technology, static_cast<std::int64_t>(candidate.technology));
    switch (candidate.technology) {
    case Technology::lte:
        record.put(Fields::earfcn, candidate.channel);
        record.put(Fields::cellIdentity, candidate.identity);
        break;
    case Technology::utran:
        record.put(Fields::uarfcn, candidate.channel);
        record.put(Fields::scramblingCode, candidate.identity);
        break;
    case Technology::geran:
        record.put(Fields::arfcn, candidate.channel);
        record.put(Fields::band, candidate.band);
        record.put(Fields::stationIdentity, candidate.identity);
        break;
    case Technology::cdma1x:
        record.put(Fields::bandClass, candidate.band);
        record.put(Fields::channel, candidate.channel);
        record.put(Fields::pilot, candidate.identity);
        break;
    }
}

/// Whether the first one's fields read right where they lie in the second one: a CDMA candidate before a
/// GERAN one, the band class being that one's priority, the channel its ARFCN, the pilot its band and BSIC.
bool mayPrecede(const ReselectionCandidate& first, const ReselectionCandidate& second)
{
    return first.technology == Technology::cdma1x && second.technology == Technology::geran &&
           first.band == second.priority && first.channel == second.channel &&
           first.identity == (second.identity << 8 | second.band);
}

} // namespace

void LteReselectionCandidates::write(MessageBatch& log, std::uint16_t servingEarfcn,
                                     std::uint16_t servingIdentity,
                                     const std::vector<ReselectionCandidate>& candidates)
{
    if (candidates.empty())
        return;
    turn = (turn + 1) % candidates.size();
    const bool pair = turn + 1 < candidates.size() && mayPrecede(candidates[turn], candidates[turn + 1]);
    const std::size_t count = pair ? 2 : 1;
    PacketWriter packet =
        log.packet(0xB186, Layout::candidates.start + Layout::candidates.stride * (count - 1) +
                               Layout::Candidate::reach);
    packet.put(Layout::version, 1);
    packet.put(Layout::servingEarfcn, servingEarfcn);
    packet.put(Layout::servingCellIdentity, servingIdentity);
    packet.put(Layout::candidateCount, static_cast<std::int64_t>(count));
    for (std::size_t index = 0; index < count; ++index)
        writeCandidate(packet.record(Layout::candidates, index), candidates[turn + index]);
}

} // namespace pelorus
