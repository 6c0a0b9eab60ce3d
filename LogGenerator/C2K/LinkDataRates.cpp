#include "LogGenerator/C2K/Decoders.h"
#include "LogGenerator/C2K/LogCode_0x1192.h"
#include "LogGenerator/C2K/LogCode_0x127E.h"
#include "platform/SystemLog.h"

#include <bit>
#include <cstring>

namespace pelorus {

namespace {

constexpr NumberText kRate = "%.2f kbps";
constexpr double kKilo = 1024.0;

/// Where the two links differ but for the layouts of their packets.
struct Link {
    LookupKey rate;
    // In the state, what the packet before said.
    Label sequenceNumber;
    Label sent;
    // In "ExtraInfo": 1 the current values, 2 those before.
    Label sequenceNumber1;
    Label sent1;
    Label sequenceNumber2;
    Label sent2;
    std::string_view tooShort;
};

constexpr Link kForward{"kFLDataRate", "FLDataSeqNum",
                        "FLDataSent",  "FLDataSeqNum1",
                        "FLDataSent1", "FLDataSeqNum2",
                        "FLDataSent2", "Log code 0x1192 is %d bytes long but must be at least %ld bytes."};
constexpr Link kReverse{"kRLDataRate", "RLDataSeqNum",
                        "RLDataSent",  "RLDataSeqNum1",
                        "RLDataSent1", "RLDataSeqNum2",
                        "RLDataSent2", "Log code 0x127e is %d bytes long but must be at least %ld bytes."};

std::uint32_t littleEndian32(const std::byte* place)
{
    std::uint32_t number = 0;
    std::memcpy(&number, place, sizeof number);
    if constexpr (std::endian::native == std::endian::big)
        number = __builtin_bswap32(number);
    return number;
}

/// All counters by their weights, of a packet that has the minimum length.
template <class Layout> std::int64_t totalOf(PacketView data)
{
    const std::byte* record = data.from(Layout::counters.start).data();
    std::int64_t total = 0;
    for (std::size_t round = 0; round < Layout::recordCount / Layout::weights.size(); ++round)
        for (const std::int32_t weight : Layout::weights) {
            std::int64_t count = 0;
            for (std::size_t counter = 0; counter < Layout::countersPerRecord; ++counter)
                count += littleEndian32(record + counter * sizeof(std::uint32_t));
            total += count * weight;
            record += Layout::counters.stride;
        }
    return total;
}

void showRate(const Link& link, State& state, const Lookup& lookup, std::uint32_t sequenceNumber,
              std::int64_t sent)
{
    const Value sequenceNumberBefore = state.at(link.sequenceNumber.text);
    const Value sentBefore = state.at(link.sent.text);
    const Value extraInfo = state.at("ExtraInfo"); // none while there is no template
    const auto note = [&extraInfo](Label label, const Value& value) {
        if (Dictionary* notes = extraInfo.dictionary())
            notes->set(label, value);
    };
    if (sequenceNumberBefore.integer() && sentBefore.integer()) {
        // The sequence number goes round in 32 bits.
        const auto before = static_cast<std::uint32_t>(*sequenceNumberBefore.integer());
        const auto steps = static_cast<std::int32_t>(sequenceNumber - before);
        if (steps >= 1) {
            const auto more = static_cast<std::int64_t>(static_cast<std::uint64_t>(sent) -
                                                        static_cast<std::uint64_t>(*sentBefore.integer()));
            lookup.publish(link.rate, kRate, static_cast<double>(more) / (steps * kKilo));
        }
        note(link.sequenceNumber2, sequenceNumberBefore);
        note(link.sent2, sentBefore);
    } else {
        lookup.publish(link.rate, "");
    }
    const Value sequenceNumberNow = std::int64_t{sequenceNumber};
    const Value sentNow = sent;
    state.set(link.sequenceNumber, sequenceNumberNow);
    state.set(link.sent, sentNow);
    note(link.sequenceNumber1, sequenceNumberNow);
    note(link.sent1, sentNow);
}

template <class Layout>
void decodePackets(const Link& link, PacketView data, State& state, const Lookup& lookup)
{
    if (!data.covers(Layout::minimumLength)) {
        systemLog(kLogError, link.tooShort, data.size(), Layout::minimumLength);
        return;
    }
    showRate(link, state, lookup, static_cast<std::uint32_t>(data[Layout::sequenceNumber]),
             totalOf<Layout>(data));
}

} // namespace

void decodeForwardLinkPackets(PacketView data, State& state, const Lookup& lookup)
{
    decodePackets<LogCode_0x1192>(kForward, data, state, lookup);
}

void decodeReverseLinkPackets(PacketView data, State& state, const Lookup& lookup)
{
    decodePackets<LogCode_0x127E>(kReverse, data, state, lookup);
}

} // namespace pelorus
