#include "tests/modem/ModemFixture.h"

#include <fmt/format.h>

namespace pelorus::test {

using namespace std::chrono_literals;

namespace {

/// "key: value" of each dictionary in braces.
std::string listText(const Value& value)
{
    std::string text;
    if (value.string())
        return *value.string();
    if (value.integer())
        return std::to_string(*value.integer());
    if (value.array()) {
        for (const Value& element : value.array()->elements)
            text += listText(element);
        return "[" + text + "]";
    }
    if (!value.dictionary())
        return "?";
    for (const auto& [key, entry] : *value.dictionary())
        text += fmt::format("{}{}: {}", text.empty() ? "" : ", ", key.text(), listText(entry));
    return "{" + text + "}";
}

} // namespace

void ModemFixture::SetUp()
{
    privateBus.start();
    fake = std::make_unique<FakeModemManager>(privateBus.address());
    settings.client = {privateBus.address(), 50ms, 300ms};
    settings.polling = {50ms, 2};
    settings.repetition = 400ms;
    settings.report = [this](const std::string& line) { lines.push_back(line); };
}

void ModemFixture::TearDown()
{
    server.reset();
    feed.reset();
    fake.reset();
}

void ModemFixture::serve(const QString& modem)
{
    settings.modem = modem;
    feed = std::make_unique<ModemFeed>(settings);
    TelephonyServer::Settings serverSettings;
    serverSettings.makeSource = feed->sourceFactory();
    serverSettings.pace = Pace::ownTiming(0);
    serverSettings.report = settings.report;
    std::string why;
    server.emplace(*PortDirectory::open(why), std::move(serverSettings));
    ASSERT_EQ(server->listen(why), PortListener::Outcome::listening) << why;
    server->acceptClients();
    feed->start({[this](const std::string& technology) {
                     technologies.push_back(technology);
                     server->changeTechnology(technology);
                 },
                 {}});
}

FakeInterfaces ModemFixture::lteModem()
{
    return {{kModemInterface,
             {{"State", 8},
              {"AccessTechnologies", 1U << 14},
              {"CurrentCapabilities", 12U},
              {"Manufacturer", "Nobody"},
              {"Model", "Thin air"},
              {"DeviceIdentifier", "first"},
              {"Sim", QVariant::fromValue(QDBusObjectPath(kSimPath))},
              {"Bearers", QVariant::fromValue(QList<QDBusObjectPath>())},
              {"CurrentModes", QVariant::fromValue(UnsignedPair{8, 0})},
              {"CurrentBands", QVariant::fromValue(QList<unsigned>{33})},
              {"OwnNumbers", QStringList{"+491713920012"}}}},
            {kModem3gppInterface,
             {{"OperatorCode", "26201"}, {"InitialEpsBearer", QVariant::fromValue(QDBusObjectPath("/"))}}},
            {kSignalInterface, {{"Rate", 0U}, {"Lte", QVariantMap{{"rsrp", -95.0}, {"rsrq", -10.0}}}}},
            {kLocationInterface, {{"Capabilities", 1U}, {"Enabled", 1U}, {"SignalsLocation", false}}}};
}

void ModemFixture::plugIn(const QString& path)
{
    fake->add(kSimPath, {{kSimInterface,
                          {{"SimIdentifier", "89490100001234567897"},
                           {"OperatorIdentifier", "26201"},
                           {"OperatorName", "Test Network"}}}});
    fake->add(path, lteModem());
}

void ModemFixture::answerLocation(const char* text)
{
    fake->answers["GetLocation"] = {{QVariant::fromValue(FakeLocation{{1U, QDBusVariant(QString(text))}})}};
}

void ModemFixture::answerCells(const QList<QVariantMap>& cells)
{
    fake->answers["GetCellInfo"] = {{QVariant::fromValue(cells)}};
}

QVariantMap ModemFixture::lteCell(bool serving, const char* identity, unsigned earfcn)
{
    return {{"cell-type", 5U}, {"serving", serving}, {"physical-ci", identity}, {"earfcn", earfcn}};
}

std::unique_ptr<TestClient> ModemFixture::client(std::vector<int> codes)
{
    auto made = std::make_unique<TestClient>("client" + std::to_string(++clients));
    EXPECT_EQ(made->createChannel(), 0);
    made->connectCommands();
    made->send(*serializePropertyList(startCommand({}, std::move(codes))));
    return made;
}

bool ModemFixture::reachable()
{
    return spinUntil([this] { return !technologies.empty() && !technologies.back().empty(); });
}

std::string ModemFixture::last(const TestClient& from, int code)
{
    for (auto message = from.messages.rbegin(); message != from.messages.rend(); ++message)
        if (codeOf(*message) == "FF:000" + std::to_string(code))
            return listText(parsePropertyList(std::span(*message).subspan(13)));
    return {};
}

int ModemFixture::count(const TestClient& of, int code)
{
    return static_cast<int>(std::ranges::count_if(of.messages, [code](const auto& message) {
        return codeOf(message) == "FF:000" + std::to_string(code);
    }));
}

bool ModemFixture::showsSoon(const TestClient& in, int code, const std::string& text)
{
    const bool shows = spinUntil([&] { return last(in, code).find(text) != std::string::npos; }, 5s);
    EXPECT_TRUE(shows) << last(in, code);
    return shows;
}

int ModemFixture::linesWith(const std::string& text) const
{
    return static_cast<int>(std::ranges::count_if(
        lines, [&](const std::string& line) { return line.find(text) != std::string::npos; }));
}

} // namespace pelorus::test
