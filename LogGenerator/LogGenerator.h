#pragma once

#include "platform/Platform.h"
#include "platform/Value.h"

#include <memory>
#include <span>
#include <string_view>

namespace pelorus {

/// The generator's share of the model, which outlives it: "Display", "DisplayState", "ExtraInfo", "History",
/// and whatever else a generator keeps there.
using State = Dictionary;

/// The contract between the monitor model and the decoders of one technology. All calls come on the main
/// thread.
class LogGenerator {
public:
    virtual ~LogGenerator() = default;

    // What every generator implements. On LogGenerator itself each throws std::logic_error.

    /// Decodes one message of the log channel.
    virtual void updateState(State& state, std::span<const std::byte> data);
    /// The object that the display tree is made from, nil when there is nothing to show. Records a history
    /// entry.
    virtual Value generateLogUsingState(State& state);
    /// The dictionary that asks the baseband for what this generator decodes; nil when there is none.
    virtual Value getStartCommand() const;
    /// What a saved snapshot holds.
    virtual std::shared_ptr<Array> getSaveContentsFromState(const State& state) const;

    /// For who saves no snapshot: from now on raw messages are dropped, and "DisplayState" is empty.
    void dropRawMessages() { keepsRawMessages = false; }

    /// Appends what is shown now to state["History"], which keeps the newest 5.
    static void updateHistoryInState(Platform& platform, State& state);

    /// The generator for a telephony server's technology identifier; null for one that is not known.
    static std::unique_ptr<LogGenerator> generatorFromTechnology(Platform& platform,
                                                                 std::string_view technology);
    /// The identifiers that generatorFromTechnology() knows.
    static std::span<const std::string_view> technologies();

protected:
    explicit LogGenerator(Platform& system) : platform(system) {}
    LogGenerator(const LogGenerator&) = delete;
    LogGenerator& operator=(const LogGenerator&) = delete;

    void init();
    /// A new array that holds the elements of state["History"].
    static std::shared_ptr<Array> historyOf(const State& state);
    /// Before a generator uses a state for the first time: drops the display, template and bookkeeping of
    /// another kind of generator and marks the state as of this `kind`. True when a display of its own kind
    /// is there.
    static bool adoptState(State& state, std::string_view kind);

    Platform& platform;
    bool keepsRawMessages = true;
};

} // namespace pelorus
