#pragma once

#include "LogGenerator/LogGenerator.h"

namespace pelorus {

/// What the generators of the Osprey family share: the raw messages since the last refresh, and the DLF file
/// that a saved snapshot carries.
class OSPLogGenerator : public LogGenerator {
public:
    /// The history, and the DLF file of everything in it. No DLF file where it cannot be made, which is
    /// logged.
    std::shared_ptr<Array> getSaveContentsFromState(const State& state) const override;
    /// Nothing when an entry of the history holds something other than raw messages.
    std::optional<Bytes> generateDlfFromState(const State& state) const;

protected:
    using LogGenerator::LogGenerator;

    void keepRawMessage(std::span<const std::byte> data)
    {
        if (keepsRawMessages)
            binData.insert(binData.end(), data.begin(), data.end());
    }
    /// Moves the raw messages into state["DisplayState"].
    void handOverRawMessages(State& state);

    Bytes binData; // messages as received, one behind the other

private:
    /// An empty buffer, in memory that was handed over and that nobody holds any more, if there is such.
    Bytes emptyBuffer(std::size_t usualSize);

    std::vector<std::shared_ptr<Bytes>> handedOver; // those of the history, mostly
};

} // namespace pelorus
