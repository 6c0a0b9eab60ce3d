#include "LogGenerator/C2K/Decoders.h"
#include "LogGenerator/C2K/LogCode_0x108A.h"
#include "LogGenerator/C2K/LogCode_0x12B6.h"
#include "LogGenerator/C2K/PilotList.h"
#include "platform/SystemLog.h"

#include <cmath>

namespace pelorus {

namespace {

constexpr NumberText kStrength = "%+.2f dB";
constexpr double kStrengthUnit = 512;
constexpr std::int64_t kUnassigned = 0xFFFF; // in place of a PN

/// Where the two reports differ.
struct Report {
    LookupKey key;
    std::size_t minimumLength;
    Field count;
    Records pilots;
    Field pn;
    Field strength;
    bool hasExactLength;
    bool skipsUnassigned;
    std::string_view tooShort;
    std::string_view badLength; // with the length, the count and the minimum length
};

constexpr Report kActiveSet{
    .key = "kActiveSetPilots",
    .minimumLength = LogCode_0x12B6::minimumLength,
    .count = LogCode_0x12B6::pilotCount,
    .pilots = LogCode_0x12B6::pilots,
    .pn = LogCode_0x12B6::Pilot::pn,
    .strength = LogCode_0x12B6::Pilot::strength,
    .hasExactLength = false,
    .skipsUnassigned = false,
    .tooShort = "Log code 0x12b6 is %u bytes long but must be at least %lu bytes.",
    .badLength = "Log code 0x12b6 is %u bytes long, but has %d substructs.",
};
constexpr Report kFingers{
    .key = "kFingerC2I",
    .minimumLength = LogCode_0x108A::minimumLength,
    .count = LogCode_0x108A::fingerCount,
    .pilots = LogCode_0x108A::fingers,
    .pn = LogCode_0x108A::Finger::pn,
    .strength = LogCode_0x108A::Finger::strength,
    .hasExactLength = true,
    .skipsUnassigned = true,
    .tooShort = "Log code 0x108a is %u bytes long but must be at least %lu bytes.",
    // The size is the one without fingers, not the one that was expected: meant.
    .badLength = "Log code 0x108a has bad length of %u bytes, but has %d substructs (size=%lu).",
};

void decodeReport(const Report& report, PacketView data, const Lookup& lookup)
{
    if (!data.covers(report.minimumLength)) {
        systemLog(kLogError, report.tooShort, data.size(), report.minimumLength);
        return;
    }
    const auto count = static_cast<std::size_t>(data[report.count]);
    const std::size_t length = report.pilots.start + count * report.pilots.stride;
    if (!data.covers(length) || (report.hasExactLength && data.size() != length)) {
        systemLog(kLogError, report.badLength, data.size(), count, report.minimumLength);
        return;
    }
    PilotList pilots(lookup.listShown(report.key));
    for (std::size_t index = 0; index < count; ++index) {
        const PacketView pilot = data.record(report.pilots, index, count);
        const std::int64_t pn = pilot[report.pn];
        if (report.skipsUnassigned && pn == kUnassigned)
            continue; // its index is used up all the same
        const std::int64_t strength = pilot[report.strength];
        pilots.add(index, pn, {&report, strength}, [strength](std::string& text) {
            kStrength.write(text, 10 * std::log10(static_cast<double>(strength) / kStrengthUnit));
        });
    }
    if (pilots.empty())
        lookup.publish(report.key, "(none)");
    else
        lookup.publish(report.key, pilots.dictionary());
}

} // namespace

void decodeActiveSetPilots(PacketView data, State&, const Lookup& lookup)
{
    decodeReport(kActiveSet, data, lookup);
}

void decodeFingers(PacketView data, State&, const Lookup& lookup)
{
    decodeReport(kFingers, data, lookup);
}

} // namespace pelorus
