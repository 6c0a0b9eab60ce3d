#pragma once

#include "LogGenerator/C2K/Lookup.h"
#include "LogGenerator/Osprey/OSPLogGenerator.h"

namespace pelorus {

/// Osprey CDMA: CDMA2000 1x and EV-DO. The display is a template whose leaves name what they show by a lookup
/// key; the decoders of the log codes publish values under those keys.
class C2KLogGenerator : public OSPLogGenerator {
public:
    static std::unique_ptr<C2KLogGenerator> generator(Platform& platform);
    explicit C2KLogGenerator(Platform& platform);

    void updateState(State& state, std::span<const std::byte> data) override;
    Value generateLogUsingState(State& state) override;
    Value getStartCommand() const override;

    /// Strips the framing of one message (optional 2-byte prefix when byte 0 is 0x81; log code at 3,
    /// little-endian), decodes it and keeps the rest as a raw message. `lookup` does not change any more;
    /// without one nothing is published.
    void updateFromLog(std::span<const std::byte> packet, const std::shared_ptr<Dictionary>& lookup,
                       State& state);
    /// The state's display, which the first call makes of the template; nil when that cannot be loaded.
    Value getDisplayFromState(State& state);
    /// Fills `display` with the template's groups and an empty row for each of its other texts, and `lookup`
    /// with where the rows of each key are. Logs a line for every group.
    static void processTemplate(const Dictionary& pattern, const std::shared_ptr<Dictionary>& display,
                                Dictionary& lookup);

private:
    /// Before this generator's first use of a state that others may have used.
    void takeOver(State& state);
    Value loadTemplate();

    bool tookOver = false;
    std::shared_ptr<Dictionary> boundLookup; // what `rows` was made of
    Lookup rows;
};

} // namespace pelorus
