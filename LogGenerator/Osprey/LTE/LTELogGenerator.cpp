#include "LogGenerator/Osprey/LTE/LTELogGenerator.h"

#include "LogGenerator/Osprey/LTE/LTEClassIndex.h"
#include "platform/SystemLog.h"

namespace pelorus {

std::unique_ptr<LTELogGenerator> LTELogGenerator::generator(Platform& platform)
{
    return std::make_unique<LTELogGenerator>(platform);
}

LTELogGenerator::LTELogGenerator(Platform& system) : OSPLogGenerator2(system)
{
    systemLog(kLogError, "Creating LTELogGenerator object");
    initWithPListName("LTE", std::make_shared<LTEClassIndex>());
}

LTELogGenerator::~LTELogGenerator()
{
    systemLog(kLogWarning, "LTELogGenerator is destructed %p", static_cast<const void*>(this));
}

} // namespace pelorus
