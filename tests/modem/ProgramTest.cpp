#include "tests/modem/ModemFixture.h"

#include <QJsonArray>
#include <QJsonDocument>
#include <QJsonObject>
#include <QProcess>

namespace pelorus {

using namespace test;

namespace {

/// The programs against the fake modem: what a modem says on one end, what the monitor shows on the other.
class ModemProgramTest : public ModemFixture {
protected:
    void TearDown() override
    {
        for (QProcess* process : {&server, &monitor}) {
            process->kill();
            process->waitForFinished();
        }
        ModemFixture::TearDown();
    }

    void startServer(const QStringList& arguments)
    {
        run(server, PELORUS_TELEPHONYD, arguments);
        ASSERT_TRUE(spinUntil([this] { return said().contains("Thin air"); })) << said().toStdString();
    }

    /// The rows by path after the update in which that one has that value, of a monitor that goes on running.
    QMap<QString, QString> shown(const QString& path, const QString& value)
    {
        if (monitor.state() == QProcess::NotRunning)
            run(monitor, PELORUSCTL, {"live", "--json"});
        QMap<QString, QString> rows;
        EXPECT_TRUE(spinUntil([&] {
            while (monitor.canReadLine())
                collect(QJsonDocument::fromJson(monitor.readLine()).object()["tree"].toObject(), rows);
            return rows.value(path) == value;
        })) << path.toStdString()
            << " is " << rows.value(path).toStdString() << '\n'
            << said().toStdString();
        return rows;
    }

    QString said()
    {
        errors += QString::fromUtf8(server.readAllStandardError());
        return errors;
    }

    QProcess server;
    QProcess monitor;

private:
    void run(QProcess& process, const char* program, const QStringList& arguments)
    {
        QProcessEnvironment environment = QProcessEnvironment::systemEnvironment();
        environment.insert("DBUS_SYSTEM_BUS_ADDRESS", privateBus.address());
        process.setProcessEnvironment(environment);
        process.start(program, arguments);
        ASSERT_TRUE(process.waitForStarted());
    }

    static void collect(const QJsonObject& node, QMap<QString, QString>& rows)
    {
        if (node.contains("value"))
            rows[node["path"].toString()] = node["value"].toString();
        for (const QJsonValue child : node["children"].toArray())
            collect(child.toObject(), rows);
    }

    QString errors;
};

} // namespace

TEST_F(ModemProgramTest, ShowLteSimAndContexts)
{
    fake->appear();
    plugIn();
    answerLocation("262,01,0,124A30B,2B0C");
    answerCells({{{"cell-type", 5U},
                  {"serving", true},
                  {"ci", "124A30B"},
                  {"physical-ci", "1A0"},
                  {"earfcn", 1300U},
                  {"rsrp", -95.0}}});
    fake->add(kBearerPath, {{kBearerInterface,
                             {{"Connected", true},
                              {"Interface", "wwan0"},
                              {"Ip4Config", QVariantMap{{"address", "192.0.2.37"}}},
                              {"Properties", QVariantMap{{"apn", "internet.example"}, {"ip-type", 1U}}}}}});
    fake->change(kModemPath, kModemInterface,
                 {{"Bearers", QVariant::fromValue(QList<QDBusObjectPath>{QDBusObjectPath(kBearerPath)})}});
    startServer({"--modem", "first"});
    const auto rows = shown("/Serving cell/Serving Cell Info/Physical Cell ID", "416");
    EXPECT_EQ(rows["/Serving cell/Serving Cell Info/Tracking Area Code"], "11020");
    EXPECT_EQ(rows["/Serving cell/Serving Cell Info/Cell Identity"], "19178251");
    EXPECT_EQ(rows["/Serving cell/Serving Cell Info/Freq Band Indicator"], "3");
    EXPECT_EQ(rows["/Serving cell/Serving Cell Info/UARFCN"], "1300");
    EXPECT_EQ(rows["/SIM/SIM Info/EF-ICCID"], "89490100001234567897");
    EXPECT_EQ(rows["/SIM/SIM Info/EF-MSISDN"], "+491713920012");
    EXPECT_THAT(rows.values(), testing::Contains("internet.example"));
    EXPECT_THAT(rows.values(), testing::Contains("192.0.2.37"));
}

TEST_F(ModemProgramTest, ShowGsmNeighboursAndFollowTheModemToLte)
{
    fake->appear();
    plugIn();
    fake->change(kModemPath, kModemInterface, {{"AccessTechnologies", 1U << 1}});
    answerLocation("262,01,31C5,F7CD,0");
    answerCells({{{"cell-type", 2U}, {"serving", true}, {"arfcn", 62U}, {"ci", "F7CD"}},
                 {{"cell-type", 2U}, {"arfcn", 975U}, {"rx-level", 40U}},
                 {{"cell-type", 2U}, {"arfcn", 1023U}}});
    startServer({"--modem"});
    auto rows = shown("/GSM/GSM Serving Cell/ARFCN", "62");
    EXPECT_EQ(rows["/GSM/GSM Serving Cell/Cell ID"], "63437");
    EXPECT_THAT(rows.values(), testing::Contains("975"));
    EXPECT_THAT(rows.values(), testing::Contains("-70 dBm"));
    EXPECT_THAT(rows.values(), testing::Contains("1023"));
    answerLocation("262,01,0,124A30B,2B0C");
    answerCells({});
    fake->change(kModemPath, kModemInterface, {{"AccessTechnologies", 1U << 14}});
    rows = shown("/Serving cell/Serving Cell Info/Tracking Area Code", "11020");
    EXPECT_TRUE(said().contains("Osprey LTE: channel 2: client connected"));
}

} // namespace pelorus
