#pragma once

#include "platform/Platform.h"
#include "platform/linux/PortListener.h"
#include "tests/linux/EventLoop.h"
#include "tests/linux/PortFixture.h"

namespace pelorus::test {

/// A connection with a raw peer at its other end.
class ConnectedPair : public PortFixture {
protected:
    void SetUp() override
    {
        std::string why;
        ASSERT_EQ(listener.listen(*PortDirectory::open(why), "port", why), PortListener::Outcome::listening);
        listener.acceptConnections([this](auto accepted) { connection = std::move(accepted); });
        peer = RawPeer::connectTo(path("port"));
        ASSERT_TRUE(spinUntil([this] { return connection != nullptr; }));
    }

    PortListener listener;
    RawPeer peer;
    std::shared_ptr<PortConnection> connection;
    std::string events;
};

} // namespace pelorus::test
