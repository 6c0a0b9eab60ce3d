#include "LogGenerator/C2K/Subpackets.h"

#include "LogGenerator/C2K/SubpacketLayout.h"
#include "platform/SystemLog.h"

namespace pelorus {

std::optional<PacketView> findSubpacket(PacketView data, unsigned identifier)
{
    using Layout = SubpacketLayout;
    // So many bytes more than the packet has, and yet no subpacket may end right there: meant.
    const std::size_t bound = Layout::start + data.size();
    const std::int64_t count = data.padded(Layout::count);
    std::size_t start = Layout::start;
    for (std::int64_t index = 0; index < count; ++index) {
        const PacketView rest(data.from(start));
        const auto size = static_cast<std::size_t>(rest.padded(Layout::size));
        if (start + size >= bound) {
            systemLog(kLogError, "Log code error in subpkt#%d: bad size (%d).", index, size);
            return std::nullopt;
        }
        if (rest.padded(Layout::identifier) == identifier)
            return PacketView(rest.from(0).first(std::min(size, rest.size())));
        start += size;
    }
    return std::nullopt;
}

} // namespace pelorus
