#include "telephonyd/simulation/PdpContexts.h"

namespace pelorus {

// Addresses and names are those set aside for documentation (RFC 5737, 3849 and 2606).
Value pdpContexts(bool inSession)
{
    auto contexts = makeArray({makeDictionary({
        {"Context ID", "5"},
        {"APN", "internet.example"},
        {"PDP Type", "IPv4v6"},
        {"IPv4 Address", "192.0.2.37"},
        {"IPv6 Address", "2001:db8:0:2a::25"},
        {"DNS", "192.0.2.53"},
        {"QoS Class", "9"},
        {"State", "Active"},
    })});
    if (inSession)
        contexts->elements.emplace_back(makeDictionary({
            {"Context ID", "6"},
            {"APN", "streaming.example"},
            {"PDP Type", "IPv4"},
            {"IPv4 Address", "192.0.2.162"},
            {"DNS", "192.0.2.53"},
            {"QoS Class", "6"},
            {"State", "Active"},
        }));
    return contexts;
}

} // namespace pelorus
