#include "LogGenerator/Osprey/LogPacket.h"

#include "platform/PropertyList.h"

namespace pelorus {

const Value& LogPacket::propertyList() const
{
    if (!parsed)
        parsed = parsePropertyList(from(kPacketHeaderLength));
    return *parsed;
}

} // namespace pelorus
