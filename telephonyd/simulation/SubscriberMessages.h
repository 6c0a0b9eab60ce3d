#pragma once

#include "telephonyd/simulation/MessageBatch.h"

namespace pelorus {

class Random;

/// What the telephony server adds to the log of any handset: the SIM's files and the packet data contexts.
class SubscriberMessages {
public:
    explicit SubscriberMessages(Random& random);

    void sim(MessageBatch& log, std::uint16_t areaCode);
    void contexts(MessageBatch& log, bool inSession);

private:
    std::uint32_t tmsi;
    std::vector<std::byte> idleContexts;
    std::vector<std::byte> sessionContexts;
};

} // namespace pelorus
