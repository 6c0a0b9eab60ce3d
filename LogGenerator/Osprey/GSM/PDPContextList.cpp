#include "LogGenerator/Osprey/GSM/PDPContextList.h"

#include "platform/SystemLog.h"

namespace pelorus {

void PDPContextList::updateWithData(const LogPacket& data, LogCode)
{
    systemLog(kLogWarning, "PDPContextList");
    const Array* contexts = data.propertyList().array();
    if (!contexts)
        return;
    std::vector<Value> elements = contexts->elements;
    replaceArray(*listEntry(), elements);
}

} // namespace pelorus
