#pragma once

#include "LogGenerator/LogGenerator.h"
#include "fuzz/AcceptedEnd.h"
#include "model/PelorusModelNode.h"

namespace pelorus::fuzz {

/// What is on the screen: the tree and its index.
struct Shown {
    std::shared_ptr<const PelorusModelNode> root;
    PathDictionary paths;
};

/// The decoding half of a monitor: a generator, the state that outlives it, and refreshes.
class GeneratorRun {
public:
    /// A state that `templates` comes from saves reading the template again.
    GeneratorRun(Platform& platform, std::string_view technology, const State& templates, bool logs);

    /// How the message ended the program; an end that is not accepted of this message is thrown.
    AcceptedEnd receive(std::span<const std::byte> message);
    Shown refresh();
    /// As when the log channel was lost: a new generator for the state that is there.
    void restart();
    /// The content of the snapshot file that would be saved.
    Value snapshot() const;
    const State& currentState() const { return state; }

private:
    Platform& platform;
    std::string_view technology;
    bool logs; // somebody reads the system log
    State state;
    std::unique_ptr<LogGenerator> generator;
};

bool isSame(const Shown& a, const Shown& b);

} // namespace pelorus::fuzz
