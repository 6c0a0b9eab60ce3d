#pragma once

#include "LogGenerator/Osprey/OSPLogGenerator2.h"

namespace pelorus {

/// Osprey UTRAN2. Its template is the first property-list resource whose path contains "UTRAN", in any case;
/// where there is none the generator has neither index nor display, and asks the baseband for nothing: meant.
class UTRANLogGenerator : public OSPLogGenerator2 {
public:
    static std::unique_ptr<UTRANLogGenerator> generator(Platform& platform);
    explicit UTRANLogGenerator(Platform& platform);
};

} // namespace pelorus
