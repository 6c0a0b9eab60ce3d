#pragma once

#include "LogGenerator/Osprey/OSPLogGenerator.h"

namespace pelorus {

/// Osprey CDMA. It decodes no log code yet, and so asks the baseband for none and shows nothing.
class C2KLogGenerator : public OSPLogGenerator {
public:
    static std::unique_ptr<C2KLogGenerator> generator(Platform& platform);
    explicit C2KLogGenerator(Platform& platform);

    void updateState(State& state, std::span<const std::byte> data) override;
    Value generateLogUsingState(State& state) override;
    Value getStartCommand() const override;
};

} // namespace pelorus
