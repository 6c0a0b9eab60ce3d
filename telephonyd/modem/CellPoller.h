#pragma once

#include "telephonyd/modem/CallSchedule.h"
#include "telephonyd/modem/ModemManagerClient.h"
#include "telephonyd/modem/ThreeGppLocation.h"

namespace pelorus {

/// Asks one modem for what it does not tell by itself: its cells and its place in the network. While it runs
/// the modem measures its signal, too. That is a setting which all programs share: it is left alone where it
/// will do, and put back at the end.
class CellPoller {
public:
    struct Settings {
        std::chrono::milliseconds interval = std::chrono::seconds(5);
        unsigned signalRate = 2; // seconds
    };

    CellPoller(ModemManagerClient& client, QString modem, Complaints& complaints, Settings settings,
               std::function<void()> changed);
    ~CellPoller();
    CellPoller(const CellPoller&) = delete;
    CellPoller& operator=(const CellPoller&) = delete;

    const QString& path() const { return modem; }
    void start();
    /// `done` is called when the modem has its settings back, or refused them.
    void stop(std::function<void()> done = {});
    /// The modem's properties changed.
    void refresh();

    const QVariantList& cells() const { return infos; } // none unless GetCellInfo() answers
    const ThreeGppLocation& location() const { return where; }

private:
    void poll();
    void arm();
    bool isEnabled() const;
    bool callWhenDue(CallSchedule& schedule, const QString& name, const QString& interface,
                     const QString& method, const QVariantList& arguments,
                     std::function<void(const QVariant&)> answer, std::function<void()> failure = {});
    bool wantsSignalRate() const;
    bool wantsLocation() const;
    void putBack(const QString& interface, const QVariantList& arguments, std::shared_ptr<QObject> last);

    ModemManagerClient& client;
    QString modem;
    Complaints& complaints;
    Settings settings;
    std::function<void()> changed;
    std::shared_ptr<bool> alive = std::make_shared<bool>(true); // replies may come later
    CallSchedule cellInfo;
    CallSchedule getLocation;
    CallSchedule signalSetup;
    CallSchedule locationSetup;
    QTimer timer;
    bool running = false;
    bool wasEnabled = false;
    std::optional<unsigned> rateBefore; // while the rate is this poller's
    bool rateSeen = false;              // the modem confirmed it
    bool locationTurnedOn = false;
    QVariantList infos;
    ThreeGppLocation where;
};

} // namespace pelorus
