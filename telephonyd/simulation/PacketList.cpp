#include "telephonyd/simulation/PacketList.h"

#include "platform/PropertyList.h"

namespace pelorus {

std::vector<std::byte> packetList(const Value& list)
{
    return serializePropertyList(list, PropertyListForm::binary).value();
}

} // namespace pelorus
