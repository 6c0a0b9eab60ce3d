#pragma once

#include "telephonyd/modem/ModemFeed.h"

namespace pelorus {

/// One channel's messages of the modem: a list when it changed, and now and then one that did not. A client
/// that does not keep up gets what is so when it takes the next message, and never what was.
class ModemSource : public MessageSource {
public:
    explicit ModemSource(ModemFeed& from);
    ~ModemSource() override;

    bool next(SourceMessage& message) override;
    bool rewind() override { return false; }
    void subscribe(const Subscription& wanted) override;
    bool awaitMore(std::function<void()> callback) override;

    bool wants(std::uint32_t code) const { return subscription.wants(code); }
    void handleNews();
    /// There will be no more: a channel that has ended may go only after all others.
    void detach() { feed = nullptr; }

private:
    using Clock = std::chrono::steady_clock;
    struct Sent {
        std::vector<std::byte> list;
        Clock::time_point time;
    };

    void arm();

    ModemFeed* feed;
    Subscription subscription;
    std::function<void()> more;
    std::array<Sent, ModemFeed::kCodes.size()> sent;
    std::vector<std::byte> current;
    Clock::time_point began = Clock::now();
    QTimer timer; // until a list is to be repeated
};

} // namespace pelorus
