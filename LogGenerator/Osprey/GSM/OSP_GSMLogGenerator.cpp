#include "LogGenerator/Osprey/GSM/OSP_GSMLogGenerator.h"

#include "LogGenerator/Osprey/GSM/OSP_GSMClassIndex.h"
#include "platform/SystemLog.h"

namespace pelorus {

std::unique_ptr<OSP_GSMLogGenerator> OSP_GSMLogGenerator::generator(Platform& platform)
{
    return std::make_unique<OSP_GSMLogGenerator>(platform);
}

OSP_GSMLogGenerator::OSP_GSMLogGenerator(Platform& system) : OSPLogGenerator2(system)
{
    systemLog(kLogError, "Creating OSP_GSMLogGenerator object");
    initWithPListName("OSP_GSM", std::make_shared<OSP_GSMClassIndex>());
}

OSP_GSMLogGenerator::~OSP_GSMLogGenerator()
{
    systemLog(kLogWarning, "OSP_GSMLogGenerator is destructed %p", static_cast<const void*>(this));
}

} // namespace pelorus
