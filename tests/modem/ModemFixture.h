#pragma once

#include "telephonyd/modem/ModemFeed.h"
#include "telephonyd/server/TelephonyServer.h"
#include "tests/linux/EventLoop.h"
#include "tests/linux/PortFixture.h"
#include "tests/modem/FakeModemManager.h"
#include "tests/modem/PrivateBus.h"
#include "tests/telephonyd/TestClient.h"

#include <gmock/gmock.h>

namespace pelorus::test {

inline const QString kModemInterface = "org.freedesktop.ModemManager1.Modem";
inline const QString kModem3gppInterface = "org.freedesktop.ModemManager1.Modem.Modem3gpp";
inline const QString kSignalInterface = "org.freedesktop.ModemManager1.Modem.Signal";
inline const QString kLocationInterface = "org.freedesktop.ModemManager1.Modem.Location";
inline const QString kSimInterface = "org.freedesktop.ModemManager1.Sim";
inline const QString kBearerInterface = "org.freedesktop.ModemManager1.Bearer";
inline const QString kModemPath = "/org/freedesktop/ModemManager1/Modem/0";
inline const QString kSimPath = "/org/freedesktop/ModemManager1/SIM/0";
inline const QString kBearerPath = "/org/freedesktop/ModemManager1/Bearer/3";

/// A telephony server that reads a made-up modem, in a tenth of the usual time or less.
class ModemFixture : public PortFixture {
protected:
    void SetUp() override;
    void TearDown() override;

    void serve(const QString& modem = {});
    /// A registered LTE modem, with a SIM.
    static FakeInterfaces lteModem();
    void plugIn(const QString& path = kModemPath);
    void answerLocation(const char* text);
    void answerCells(const QList<QVariantMap>& cells);
    static QVariantMap lteCell(bool serving, const char* identity, unsigned earfcn);

    /// A client that asked for those of the server's own codes, 0 to 2.
    std::unique_ptr<TestClient> client(std::vector<int> codes = {0, 1, 2});
    /// Until a client is given a channel.
    bool reachable();
    /// The payload of the last message of that code, as text; empty while there is none.
    static std::string last(const TestClient& from, int code);
    static int count(const TestClient& of, int code);
    bool showsSoon(const TestClient& in, int code, const std::string& text);
    int linesWith(const std::string& text) const;

    PrivateBus privateBus;
    std::unique_ptr<FakeModemManager> fake;
    std::vector<std::string> lines;
    std::vector<std::string> technologies;
    ModemFeed::Settings settings;
    std::unique_ptr<ModemFeed> feed;
    std::optional<TelephonyServer> server;
    int clients = 0;
};

} // namespace pelorus::test
