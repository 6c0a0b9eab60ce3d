#include "tests/model/ModelFixture.h"

namespace pelorus::test {
namespace {

using testing::ElementsAre;

class CreatePorts : public ModelFixture {};

TEST_F(CreatePorts, AskTheServerForAChannelToTheLocalPort)
{
    model->startMonitor();
    EXPECT_THAT(platform.calls,
                ElementsAre("createLocalMessagePort io.pelorus.BasebandStateReport.LogChannel",
                            "deliverOnMainQueue io.pelorus.BasebandStateReport.LogChannel",
                            "setInvalidationCallback io.pelorus.BasebandStateReport.LogChannel",
                            "createServerConnection",
                            "createLogChannel io.pelorus.BasebandStateReport.LogChannel",
                            "createRemoteMessagePort io.pelorus.ScriptedRemotePort",
                            "sendPortRequest io.pelorus.ScriptedRemotePort",
                            "sendPortRequest io.pelorus.ScriptedRemotePort"));
    EXPECT_EQ(errors().front(), " ***** Created ports (send=%p, recv=%p)");
    EXPECT_TRUE(model->isConnected());
}

TEST_F(CreatePorts, NamesTheSendPortFirst)
{
    model->startMonitor();
    const std::string line = log.take().front();
    const auto address = [](const void* port) { return fmt::sprintf("%p", port); };
    EXPECT_EQ(line, "<3> ***** Created ports (send=" +
                        address(static_cast<MessagePort*>(platform.remotePort().get())) +
                        ", recv=" + address(static_cast<MessagePort*>(platform.localPort().get())) + ")");
}

TEST_F(CreatePorts, ReleasesTheServerConnectionAfterTheCall)
{
    int during = 0;
    platform.duringLogChannel = [&] { during = platform.notifyFromServer(); };
    model->startMonitor();
    EXPECT_EQ(during, 1);
    EXPECT_EQ(platform.notifyFromServer(), 0);
}

TEST_F(CreatePorts, ReleasesTheServerConnectionAfterAnErrorToo)
{
    platform.logChannelError = 3;
    model->startMonitor();
    EXPECT_EQ(platform.notifyFromServer(), 0);
}

TEST_F(CreatePorts, ServerNotificationRefreshes)
{
    startWith("Osprey LTE");
    platform.deliver(simFiles("8949"));
    platform.breakPort(*platform.localPort()); // a new channel is made, and the data is still new
    platform.runMainQueue();
    ASSERT_EQ(observer.updates, 0);

    platform.duringLogChannel = [&] { platform.notifyFromServer(); };
    model->restartMonitor();
    platform.runMainQueue();
    EXPECT_EQ(observer.updates, 1);
}

TEST_F(CreatePorts, NoLocalPort)
{
    platform.localPortFails = true;
    model->startMonitor();
    EXPECT_THAT(errors(),
                ElementsAre("Could not create local message port", "Could not create the ports necessary"));
    EXPECT_THAT(platform.calls,
                ElementsAre("createLocalMessagePort io.pelorus.BasebandStateReport.LogChannel"));
}

TEST_F(CreatePorts, LocalPortOfThatNameExists)
{
    platform.localPortExisted = true;
    model->startMonitor();
    EXPECT_THAT(errors(),
                ElementsAre("Local messsage port already exists", "Could not create the ports necessary"));
    // It is kept until the ports are torn down for the next attempt.
    EXPECT_THAT(platform.calls,
                ElementsAre("createLocalMessagePort io.pelorus.BasebandStateReport.LogChannel",
                            "clearInvalidationCallback io.pelorus.BasebandStateReport.LogChannel",
                            "invalidatePort io.pelorus.BasebandStateReport.LogChannel"));
}

TEST_F(CreatePorts, NoServer)
{
    platform.serverPresent = false;
    model->startMonitor();
    EXPECT_THAT(errors(),
                ElementsAre("Could not create HXServerConnection", "Could not create the ports necessary"));
}

TEST_F(CreatePorts, ServerRefusesTheChannel)
{
    platform.logChannelError = 2;
    model->startMonitor();
    EXPECT_THAT(errors(), ElementsAre("_HXServerConnectionNetworkMonitorCreateLogChannel returns error: 2!",
                                      "Could not create the ports necessary"));
}

TEST_F(CreatePorts, ServerRefusesTheChannelWithANegativeCode)
{
    platform.logChannelError = -2;
    model->startMonitor();
    EXPECT_EQ(errors().front(), "_HXServerConnectionNetworkMonitorCreateLogChannel returns error: -2!");
}

TEST_F(CreatePorts, ServerNamesNoPort)
{
    platform.remotePortName.clear();
    model->startMonitor();
    EXPECT_THAT(errors(), ElementsAre("Could not create a log channel (HX returned null port)!",
                                      "Could not create the ports necessary"));
}

TEST_F(CreatePorts, RemotePortCannotBeMade)
{
    platform.remotePortFails = true;
    model->startMonitor();
    EXPECT_THAT(errors(),
                ElementsAre("Could not create the remote port!", "Could not create the ports necessary"));
    EXPECT_FALSE(model->isConnected());
}

TEST_F(CreatePorts, LocalPortAloneIsNoConnection)
{
    bool connected = true;
    platform.duringLogChannel = [&] { connected = model->isConnected(); };
    model->startMonitor();
    EXPECT_FALSE(connected);
}

TEST_F(CreatePorts, EveryFailureIsTriedAgainFiveSecondsLater)
{
    const std::vector<std::function<void(bool)>> troubles = {
        [this](bool on) { platform.localPortFails = on; },
        [this](bool on) { platform.localPortExisted = on; },
        [this](bool on) { platform.serverPresent = !on; },
        [this](bool on) { platform.logChannelError = on ? 1 : 0; },
        [this](bool on) { platform.remotePortName = on ? "" : "io.pelorus.ScriptedRemotePort"; },
        [this](bool on) { platform.remotePortFails = on; },
    };
    for (const auto& trouble : troubles) {
        trouble(true);
        model->startMonitor();
        EXPECT_FALSE(model->isConnected());
        trouble(false);
        platform.advance(4999ms);
        EXPECT_FALSE(started());
        platform.advance(1ms);
        EXPECT_TRUE(started());
        EXPECT_TRUE(model->isConnected());
        model->destroyPorts();
    }
}

} // namespace
} // namespace pelorus::test
