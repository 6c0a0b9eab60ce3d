#pragma once

#include "LogGenerator/Osprey/OSPLogGenerator2.h"

namespace pelorus {

/// Osprey LTE.
class LTELogGenerator : public OSPLogGenerator2 {
public:
    static std::unique_ptr<LTELogGenerator> generator(Platform& platform);
    explicit LTELogGenerator(Platform& platform);
    ~LTELogGenerator() override;
};

} // namespace pelorus
