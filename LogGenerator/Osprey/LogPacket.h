#pragma once

#include "LogGenerator/Osprey/PacketView.h"
#include "platform/Value.h"

#include <optional>

namespace pelorus {

/// A log code: 16 bits for one of the baseband, that value OR 0xFF0000 for one of the telephony server
/// itself.
using LogCode = std::uint32_t;

constexpr LogCode kInternalCodes = 0xFF0000;
constexpr LogCode kSimFiles = 0xFF0000;
constexpr LogCode kCellMonitorList = 0xFF0001;
constexpr LogCode kPDPContexts = 0xFF0002;
constexpr std::size_t kPacketHeaderLength = 13;

/// One log packet on its way to the sections, without its prefix. Several sections read the same packet, so
/// what is costly to make of it is made once.
class LogPacket : public PacketView {
public:
    using PacketView::PacketView;

    /// The property list that follows the header; nil when there is none that can be read.
    const Value& propertyList() const;

private:
    mutable std::optional<Value> parsed;
};

} // namespace pelorus
