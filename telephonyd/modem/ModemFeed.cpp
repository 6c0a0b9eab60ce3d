#include "telephonyd/modem/ModemFeed.h"

#include "telephonyd/modem/BearerRows.h"
#include "telephonyd/modem/ModemCells.h"
#include "telephonyd/modem/ModemChoice.h"
#include "telephonyd/modem/ModemNames.h"
#include "telephonyd/modem/ModemSimFiles.h"
#include "telephonyd/modem/ModemSource.h"
#include "telephonyd/modem/PlainValue.h"
#include "telephonyd/simulation/PacketList.h"

#include <algorithm>
#include <fmt/format.h>

namespace pelorus {

namespace {

using namespace ModemNames;

bool isPath(const QString& path)
{
    return path.size() > 1; // "/" stands for none
}

QString signalKey(CellKind kind)
{
    return kind == CellKind::lte    ? QStringLiteral("Lte")
           : kind == CellKind::umts ? QStringLiteral("Umts")
                                    : QStringLiteral("Gsm");
}

std::string stateText(int state)
{
    switch (state) {
    case kStateLocked:
        return "is locked: its SIM needs a PIN (mmcli -i any --pin=PIN)";
    case kStateDisabled:
        return "is not enabled, and tells nothing of its network (mmcli -m any -e enables it)";
    default:
        return {};
    }
}

} // namespace

ModemFeed::ModemFeed(Settings given)
    : settings(std::move(given)), complaints(settings.report), client(settings.client, complaints)
{}

ModemFeed::~ModemFeed() = default;

void ModemFeed::start(std::function<void(const std::string&)> callback)
{
    technologyChanged = std::move(callback);
    client.start([this] { update(); });
}

SourceFactory ModemFeed::sourceFactory()
{
    return [this](std::string& why) -> std::unique_ptr<MessageSource> {
        if (!technology.empty())
            return std::make_unique<ModemSource>(*this);
        if (!modem.isEmpty())
            why = "the modem is neither of LTE nor of GSM and UMTS";
        else if (!client.whyUnknown().empty())
            why = client.whyUnknown();
        else
            why = whyNoModem(client.objects(), settings.modem);
        return nullptr;
    };
}

void ModemFeed::finish(std::function<void()> done)
{
    if (poller)
        poller->stop(std::move(done));
    else
        done();
}

void ModemFeed::add(ModemSource& source)
{
    sources.insert(&source);
}

void ModemFeed::remove(ModemSource& source)
{
    sources.erase(&source);
    handleWishes();
}

void ModemFeed::handleWishes()
{
    const bool wanted =
        std::ranges::any_of(sources, [](const ModemSource* source) { return source->wants(kCells); });
    if (wanted == polled)
        return;
    polled = wanted;
    if (poller)
        wanted ? poller->start() : poller->stop();
}

void ModemFeed::update()
{
    choose();
    followObjects();
    updateTechnology();
    if (poller)
        poller->refresh();
    updateLists();
}

QVariantMap ModemFeed::modemProperties() const
{
    return client.objects().properties(modem, kModem);
}

void ModemFeed::choose()
{
    const QString chosen = chooseModem(client.objects(), settings.modem, modem);
    if (chosen != modem) {
        if (poller && polled)
            poller->stop(); // of one that is still there
        poller.reset();
        modem = chosen;
        for (const char* topic : {"GetCellInfo", "GetLocation", "Signal.Setup", "Location.Setup"})
            complaints.isOver(topic); // the next one's own
        if (!modem.isEmpty()) {
            poller = std::make_unique<CellPoller>(client, modem, complaints, settings.polling,
                                                  [this] { updateLists(); });
            if (polled)
                poller->start();
        }
    }
    reportState();
}

void ModemFeed::reportState()
{
    if (modem.isEmpty()) {
        complaints.isOver("state");
        if (client.whyUnknown().empty())
            complaints.say("modem", "modem: " + whyNoModem(client.objects(), settings.modem));
        else
            complaints.isOver("modem");
        return;
    }
    const QVariantMap properties = modemProperties();
    complaints.say("modem",
                   fmt::format("modem: {} {}, device identifier {}", textAt(properties, "Manufacturer"),
                               textAt(properties, "Model"), textAt(properties, "DeviceIdentifier")));
    if (const std::string text = stateText(stateOf(properties)); !text.empty())
        complaints.say("state", "modem: " + text);
    else if (stateOf(properties) >= kStateEnabled)
        complaints.isOver("state");
}

QString ModemFeed::simPath() const
{
    return modemProperties().value(QStringLiteral("Sim")).toString();
}

QStringList ModemFeed::bearerPaths() const
{
    QStringList paths;
    for (const QVariant& path : listAt(modemProperties(), "Bearers"))
        paths.append(path.toString());
    const QString initial =
        client.objects().properties(modem, kModem3gpp).value(QStringLiteral("InitialEpsBearer")).toString();
    if (!paths.contains(initial))
        paths.prepend(initial);
    paths.removeIf([](const QString& path) { return !isPath(path); });
    return paths;
}

void ModemFeed::followObjects()
{
    QMap<QString, QString> wanted;
    if (isPath(simPath()))
        wanted.insert(simPath(), kSim);
    for (const QString& path : bearerPaths())
        wanted.insert(path, kBearer);
    client.follow(wanted);
}

void ModemFeed::updateTechnology()
{
    std::string now;
    if (!modem.isEmpty()) {
        const QVariantMap properties = modemProperties();
        now = technologyOn(servingKind(unsignedAt(properties, "AccessTechnologies").value_or(0)));
        if (now.empty()) // a modem that lost its network is likely to find the same again
            now = technology;
        if (now.empty())
            now = technologyAbleTo(unsignedAt(properties, "CurrentCapabilities").value_or(0));
    }
    if (now == technology)
        return;
    technology = now;
    technologyChanged(technology);
}

Value ModemFeed::cellList() const
{
    const ObjectTree& objects = client.objects();
    const QVariantMap properties = modemProperties();
    ServingCellFacts facts;
    facts.kind = servingKind(unsignedAt(properties, "AccessTechnologies").value_or(0));
    facts.location = poller->location();
    facts.operatorCode = OperatorCode::parse(textAt(objects.properties(modem, kModem3gpp), "OperatorCode"));
    facts.signal = objects.properties(modem, kSignal).value(signalKey(facts.kind)).toMap();
    facts.bands = listAt(properties, "CurrentBands");
    return cellMonitorList(poller->cells(), facts);
}

std::vector<std::byte> ModemFeed::contextList() const
{
    auto contexts = makeArray();
    for (const QString& path : bearerPaths()) {
        if (!client.objects().has(path, kBearer))
            continue; // not told of yet
        contexts->elements.push_back(bearerRows(path, client.objects().properties(path, kBearer)));
    }
    return packetList(contexts);
}

void ModemFeed::updateLists()
{
    lists = {};
    if (!modem.isEmpty()) {
        const QString sim = simPath();
        if (!isPath(sim) || client.objects().has(sim, kSim))
            lists[kSimFiles - kSimFiles] =
                packetList(simFilesOf(client.objects().properties(sim, kSim), modemProperties()));
        lists[kCells - kSimFiles] = packetList(cellList());
        lists[kContexts - kSimFiles] = contextList();
    }
    const auto told = sources; // one that is told may go
    for (ModemSource* source : told)
        if (sources.contains(source))
            source->handleNews();
}

} // namespace pelorus
