#pragma once

#include "telephonyd/simulation/MessageBatch.h"

namespace pelorus {

/// A made-up handset of one technology.
class Handset {
public:
    Handset() = default;
    virtual ~Handset() = default;
    Handset(const Handset&) = delete;
    Handset& operator=(const Handset&) = delete;

    /// Lives on for a moment, and logs at least one message within a bounded number of moments. Time never
    /// goes back, from one batch to the next either.
    virtual void step(MessageBatch& log) = 0;
};

} // namespace pelorus
