#include "LogGenerator/Osprey/GSM/EquivalentPLMNList.h"

#include "LogGenerator/Osprey/GSM/LogCode_0x7150.h"

namespace pelorus {

namespace {

using Layout = LogCode_0x7150;
using Network = Layout::Network;
constexpr Format kCode = "%d";

std::int64_t decimal(PacketView network, std::span<const Field, 3> digits)
{
    return network[digits[0]] * 100 + network[digits[1]] * 10 + network[digits[2]];
}

void showNetworks(TableSection& section, const LogPacket& data)
{
    const std::size_t count =
        data.wholeRecords(Layout::networks, static_cast<std::size_t>(data[Layout::networkCount]));
    section.buildList(count, [&](std::size_t index, RowWriter& rows) {
        const PacketView network = data.record(Layout::networks, index, count);
        kCode.write(rows.next("Mobile Country Code").text(), decimal(network, Network::countryCode));
        kCode.write(rows.next("Mobile Network Code").text(), decimal(network, Network::networkCode));
        return true;
    });
}

constexpr Reading kReadings[] = {{0x7150, Layout::minimumLength, {}, showNetworks, overtakesAlways}};
constexpr SectionDescription kDescription{"Equivalent PLMN List", "Equivalent PLMN List", kReadings};

} // namespace

EquivalentPLMNList::EquivalentPLMNList() : TableSection(kDescription) {}

} // namespace pelorus
