#pragma once

#include "LogGenerator/Osprey/OSPLogGenerator2.h"

namespace pelorus {

/// Osprey GSM.
class OSP_GSMLogGenerator : public OSPLogGenerator2 {
public:
    static std::unique_ptr<OSP_GSMLogGenerator> generator(Platform& platform);
    explicit OSP_GSMLogGenerator(Platform& platform);
    ~OSP_GSMLogGenerator() override;
};

} // namespace pelorus
