#include "telephonyd/modem/CellPoller.h"

#include "telephonyd/modem/ModemChoice.h"
#include "telephonyd/modem/ModemNames.h"
#include "telephonyd/modem/PlainValue.h"

#include <algorithm>

namespace pelorus {

namespace {

using namespace ModemNames;

constexpr std::uint32_t kLocationArea = 1; // MM_MODEM_LOCATION_SOURCE_3GPP_LAC_CI
const QString kSetup = QStringLiteral("Setup");

CallSchedule::Time now()
{
    return CallSchedule::Clock::now();
}

} // namespace

CellPoller::CellPoller(ModemManagerClient& client, QString modem, Complaints& complaints, Settings settings,
                       std::function<void()> changed)
    : client(client), modem(std::move(modem)), complaints(complaints), settings(settings),
      changed(std::move(changed)), cellInfo(settings.interval), getLocation(settings.interval),
      signalSetup(settings.interval), locationSetup(settings.interval)
{
    timer.setSingleShot(true);
    timer.setTimerType(Qt::PreciseTimer);
    QObject::connect(&timer, &QTimer::timeout, &timer, [this] { poll(); });
}

CellPoller::~CellPoller()
{
    *alive = false;
}

void CellPoller::start()
{
    running = true;
    refresh();
}

bool CellPoller::isEnabled() const
{
    return stateOf(client.objects().properties(modem, kModem)) >= kStateEnabled;
}

void CellPoller::refresh()
{
    if (!running)
        return;
    const bool enabled = isEnabled();
    if (enabled && !wasEnabled)
        for (CallSchedule* schedule : {&cellInfo, &getLocation, &signalSetup, &locationSetup})
            schedule->retryAt(now());
    wasEnabled = enabled;
    const auto rate = unsignedAt(client.objects().properties(modem, kSignal), "Rate");
    if (rateBefore && rate == settings.signalRate)
        rateSeen = true;
    else if (rateBefore && rateSeen)
        rateBefore.reset(); // somebody else's now
    poll();
}

bool CellPoller::wantsSignalRate() const
{
    const QVariantMap signal = client.objects().properties(modem, kSignal);
    const auto rate = unsignedAt(signal, "Rate");
    return rate && (*rate == 0 || *rate > settings.signalRate);
}

bool CellPoller::wantsLocation() const
{
    const QVariantMap location = client.objects().properties(modem, kLocation);
    return (unsignedAt(location, "Capabilities").value_or(0) & kLocationArea) != 0 &&
           (unsignedAt(location, "Enabled").value_or(0) & kLocationArea) == 0;
}

bool CellPoller::callWhenDue(CallSchedule& schedule, const QString& name, const QString& interface,
                             const QString& method, const QVariantList& arguments,
                             std::function<void(const QVariant&)> answer, std::function<void()> failure)
{
    const auto due = schedule.due();
    if (!due || *due > now())
        return false;
    schedule.started();
    client.call(modem, interface, method, arguments,
                [this, stillHere = alive, &schedule, name, answer = std::move(answer),
                 failure = std::move(failure)](const QDBusMessage& reply) {
                    if (!*stillHere)
                        return;
                    if (reply.type() != QDBusMessage::ErrorMessage) {
                        schedule.succeeded(now());
                        complaints.isOver(name.toStdString());
                        answer(plainValue(reply.arguments().value(0)));
                    } else {
                        complaints.say(name.toStdString(),
                                       explainError(name, reply.errorName(), reply.errorMessage()));
                        if (isUnsupported(reply.errorName()))
                            schedule.isImpossible();
                        else
                            schedule.failed(now());
                        if (failure)
                            failure();
                    }
                    arm();
                });
    return true;
}

void CellPoller::poll()
{
    if (!running || !isEnabled()) {
        timer.stop();
        return;
    }
    const ObjectTree& objects = client.objects();
    if (wantsSignalRate()) {
        const auto before = unsignedAt(objects.properties(modem, kSignal), "Rate");
        if (callWhenDue(
                signalSetup, QStringLiteral("Signal.Setup"), kSignal, kSetup, {settings.signalRate},
                [](const QVariant&) {}, [this] { rateBefore.reset(); })) {
            rateBefore = before;
            rateSeen = false;
        }
    }
    if (wantsLocation()) {
        const QVariantMap location = objects.properties(modem, kLocation);
        if (callWhenDue(
                locationSetup, QStringLiteral("Location.Setup"), kLocation, kSetup,
                {unsignedAt(location, "Enabled").value_or(0) | kLocationArea,
                 flagAt(location, "SignalsLocation")},
                [this](const QVariant&) { getLocation.retryAt(now()); },
                [this] { locationTurnedOn = false; }))
            locationTurnedOn = true;
    }
    if (objects.has(modem, kLocation))
        callWhenDue(
            getLocation, QStringLiteral("GetLocation"), kLocation, QStringLiteral("GetLocation"), {},
            [this](const QVariant& reply) {
                where = ThreeGppLocation::parse(textAt(reply.toMap(), "1"));
                changed();
            },
            [this] {
                where = {};
                changed();
            });
    callWhenDue(
        cellInfo, QStringLiteral("GetCellInfo"), kModem, QStringLiteral("GetCellInfo"), {},
        [this](const QVariant& reply) {
            infos = reply.toList();
            changed();
        },
        [this] {
            infos.clear();
            changed();
        });
    arm();
}

void CellPoller::arm()
{
    if (!running)
        return;
    std::optional<CallSchedule::Time> earliest;
    const auto consider = [&](const CallSchedule& schedule, bool counts) {
        if (const auto due = schedule.due(); counts && due)
            earliest = std::min(*due, earliest.value_or(*due));
    };
    consider(cellInfo, true);
    consider(getLocation, client.objects().has(modem, kLocation));
    consider(signalSetup, wantsSignalRate());
    consider(locationSetup, wantsLocation());
    if (!earliest)
        timer.stop();
    else
        timer.start(std::max(std::chrono::ceil<std::chrono::milliseconds>(*earliest - now()),
                             std::chrono::milliseconds(0)));
}

void CellPoller::putBack(const QString& interface, const QVariantList& arguments,
                         std::shared_ptr<QObject> last)
{
    client.call(modem, interface, kSetup, arguments, [last = std::move(last)](const QDBusMessage&) {});
}

void CellPoller::stop(std::function<void()> done)
{
    running = false;
    timer.stop();
    infos.clear();
    where = {};
    // Goes with the last reply.
    const std::shared_ptr<QObject> last(new QObject, [done = std::move(done)](QObject* object) {
        delete object;
        if (done)
            done();
    });
    if (rateBefore)
        putBack(kSignal, {*rateBefore}, last);
    rateBefore.reset();
    const QVariantMap location = client.objects().properties(modem, kLocation);
    if (locationTurnedOn)
        putBack(kLocation,
                {unsignedAt(location, "Enabled").value_or(0) & ~kLocationArea,
                 flagAt(location, "SignalsLocation")},
                last);
    locationTurnedOn = false;
}

} // namespace pelorus
