#pragma once

#include "LogGenerator/LogGenerator.h"

namespace pelorus {

/// IFX. It does not read the baseband's property lists yet, and so shows nothing.
class GSMLogGenerator : public LogGenerator {
public:
    static std::unique_ptr<GSMLogGenerator> generator(Platform& platform);
    explicit GSMLogGenerator(Platform& platform);

    void updateState(State& state, std::span<const std::byte> data) override;
    Value generateLogUsingState(State& state) override;
    Value getStartCommand() const override;
    std::shared_ptr<Array> getSaveContentsFromState(const State& state) const override;
};

} // namespace pelorus
