#pragma once

#include "telephonyd/server/ReplaySource.h"
#include "telephonyd/server/SimulationSource.h"
#include "telephonyd/server/TelephonyServer.h"
#include "tests/linux/EventLoop.h"
#include "tests/linux/PortFixture.h"
#include "tests/telephonyd/TestClient.h"

#include <QDir>
#include <gmock/gmock.h>

namespace pelorus::test {

/// A server in a port directory of its own.
class ServerFixture : public PortFixture {
protected:
    TelephonyServer::Settings simulated(Pace pace = Pace::ownTiming(1))
    {
        TelephonyServer::Settings settings;
        settings.technology = "Osprey LTE";
        settings.makeSource = SimulationSource::factory("Osprey LTE", 1);
        settings.pace = pace;
        settings.report = [this](const std::string& line) { lines.push_back(line); };
        return settings;
    }
    TelephonyServer::Settings replayed(const std::string& recording, Pace pace, bool loop = false)
    {
        TelephonyServer::Settings settings = simulated(pace);
        settings.makeSource = ReplaySource::factory(recording, settings.report);
        settings.loop = loop;
        return settings;
    }

    void serve(TelephonyServer::Settings settings)
    {
        std::string why;
        server.emplace(*PortDirectory::open(why), std::move(settings));
        ASSERT_EQ(server->listen(why), PortListener::Outcome::listening) << why;
        server->acceptClients();
    }

    std::vector<std::string> sockets() const
    {
        std::vector<std::string> names;
        for (const QString& name :
             QDir(directory.path()).entryList(QDir::System | QDir::Files | QDir::Hidden))
            names.push_back(name.toStdString());
        return names;
    }

    std::vector<std::string> lines; // of the server's reports; they outlive it
    std::optional<TelephonyServer> server;
};

} // namespace pelorus::test
