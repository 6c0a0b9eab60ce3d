#include "telephonyd/modem/BearerRows.h"

#include "telephonyd/modem/PlainValue.h"

namespace pelorus {

namespace {

std::string typeText(std::optional<std::uint32_t> ipType)
{
    switch (ipType.value_or(0)) {
    case 1:
        return "IPv4";
    case 2:
        return "IPv6";
    case 4:
        return "IPv4v6";
    case 8:
        return "Non-IP";
    default:
        return {};
    }
}

std::string stateText(const QVariantMap& bearer)
{
    if (!flagAt(bearer, "Connected"))
        return "Inactive";
    return flagAt(bearer, "Suspended") ? "Suspended" : "Active";
}

void add(Dictionary& rows, std::string_view label, const std::string& text)
{
    if (!text.empty())
        rows.set(label, text);
}

std::string nameServers(const QVariantMap& four, const QVariantMap& six)
{
    std::string text;
    for (const QVariantMap& configuration : {four, six})
        for (const char* key : {"dns1", "dns2", "dns3"})
            if (const std::string address = textAt(configuration, key); !address.empty())
                text += (text.empty() ? "" : ", ") + address;
    return text;
}

void addCount(Dictionary& rows, std::string_view label, std::optional<std::uint64_t> count,
              const char* unit = "")
{
    if (count)
        rows.set(label, std::to_string(*count) + unit);
}

} // namespace

Value bearerRows(const QString& path, const QVariantMap& bearer)
{
    const QVariantMap settings = mapAt(bearer, "Properties");
    const QVariantMap four = mapAt(bearer, "Ip4Config");
    const QVariantMap six = mapAt(bearer, "Ip6Config");
    const QVariantMap stats = mapAt(bearer, "Stats");
    auto rows = makeDictionary();
    add(*rows, "Context ID", path.section('/', -1).toStdString());
    add(*rows, "APN", textAt(settings, "apn"));
    add(*rows, "PDP Type", typeText(unsignedAt(settings, "ip-type")));
    add(*rows, "State", stateText(bearer));
    add(*rows, "Interface", textAt(bearer, "Interface"));
    add(*rows, "IPv4 Address", textAt(four, "address"));
    add(*rows, "IPv6 Address", textAt(six, "address"));
    add(*rows, "DNS", nameServers(four, six));
    addCount(*rows, "Duration", longAt(stats, "duration"), " s");
    addCount(*rows, "Bytes In", longAt(stats, "rx-bytes"));
    addCount(*rows, "Bytes Out", longAt(stats, "tx-bytes"));
    return rows;
}

} // namespace pelorus
