#include "telephonyd/modem/ModemFeed.h"

#include "telephonyd/modem/ModemChoice.h"
#include "telephonyd/modem/ModemNames.h"
#include "telephonyd/modem/ModemSource.h"
#include "telephonyd/modem/PlainValue.h"
#include "telephonyd/simulation/PacketList.h"

#include <algorithm>
#include <fmt/format.h>

namespace pelorus {

namespace {

using namespace ModemNames;

/// Clients wait a second for an answer of the server.
constexpr std::chrono::milliseconds kLongestQuestion{700};

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
    : settings(std::move(given)), complaints(settings.report), client(settings.client, complaints),
      view(client.objects())
{}

ModemFeed::~ModemFeed()
{
    for (ModemSource* source : sources)
        source->detach();
}

void ModemFeed::start(Callbacks whatToCall)
{
    callbacks = std::move(whatToCall);
    QTimer::singleShot(kLongestQuestion, &lifetime, [this] { endQuestion(); });
    client.start([this] {
        update();
        endQuestion();
    });
}

void ModemFeed::endQuestion()
{
    if (const auto asked = std::exchange(callbacks.asked, nullptr))
        asked();
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
    client.follow(view.companions());
    updateTechnology();
    if (poller)
        poller->refresh();
    updateLists();
}

void ModemFeed::choose()
{
    const QString chosen = chooseModem(client.objects(), settings.modem, modem);
    if (chosen != modem) {
        if (poller && polled)
            poller->stop(); // of one that is still there
        poller.reset();
        modem = chosen;
        view.look(modem);
        lastOnNetwork.clear();
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
    const QVariantMap properties = view.properties();
    complaints.say("modem",
                   fmt::format("modem: {} {}, device identifier {}", textAt(properties, "Manufacturer"),
                               textAt(properties, "Model"), textAt(properties, "DeviceIdentifier")));
    if (const std::string text = stateText(stateOf(properties)); !text.empty())
        complaints.say("state", "modem: " + text);
    else if (stateOf(properties) >= kStateEnabled)
        complaints.isOver("state");
}

void ModemFeed::updateTechnology()
{
    std::string now;
    if (view.isThere()) {
        now = technologyOn(view.servingKind());
        if (now.empty()) // who lost a network is likely to find the same again
            now = lastOnNetwork;
        lastOnNetwork = now;
        if (now.empty())
            now = technologyAbleTo(unsignedAt(view.properties(), "CurrentCapabilities").value_or(0));
    }
    if (now == technology)
        return;
    technology = now;
    callbacks.technologyChanged(technology);
}

void ModemFeed::updateLists()
{
    lists = {};
    if (view.isThere()) {
        const auto put = [this](std::uint32_t code, const Value& list) {
            if (list)
                lists[code - kSimFiles] = packetList(list);
        };
        put(kSimFiles, view.simFiles());
        put(kCells, view.cells(poller->cells(), poller->location()));
        put(kContexts, view.contexts());
    }
    const auto told = sources; // one that is told may go
    for (ModemSource* source : told)
        if (sources.contains(source))
            source->handleNews();
}

} // namespace pelorus
