#pragma once

#include "LogGenerator/LogGenerator.h"

namespace pelorus {

/// IFX. Such a baseband sends its whole display as one property list of dictionaries, arrays and strings;
/// each message replaces all that was shown. One that is no such list is logged and changes nothing.
class GSMLogGenerator : public LogGenerator {
public:
    static std::unique_ptr<GSMLogGenerator> generator(Platform& platform);
    explicit GSMLogGenerator(Platform& platform);

    void updateState(State& state, std::span<const std::byte> data) override;
    Value generateLogUsingState(State& state) override;
    Value getStartCommand() const override;
    std::shared_ptr<Array> getSaveContentsFromState(const State& state) const override;

    /// The object in the shape in which it is shown, in containers of its own: arrays without their first
    /// element, dictionaries of one entry as that entry's value, except at the top. Throws
    /// InternalInconsistencyException for anything but dictionaries, arrays and strings.
    static Value processObject(const Value& object);
    /// The only value of a dictionary that has just one entry, nil for any other object.
    static Value canCollapse(const Value& object);
};

} // namespace pelorus
