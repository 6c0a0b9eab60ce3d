#pragma once

#include "telephonyd/modem/CellPoller.h"
#include "telephonyd/modem/ModemView.h"
#include "telephonyd/server/MessageSource.h"

#include <array>
#include <set>

namespace pelorus {

class ModemSource;

/// The machine's modem as channels see it: its technology, and the three lists that the telephony server
/// makes of what it tells.
class ModemFeed {
public:
    static constexpr std::uint32_t kSimFiles = 0xFF0000;
    static constexpr std::uint32_t kCells = 0xFF0001;
    static constexpr std::uint32_t kContexts = 0xFF0002;
    static constexpr std::array kCodes = {kSimFiles, kCells, kContexts};

    struct Settings {
        QString modem; // a device identifier; empty for the first
        ModemManagerClient::Settings client = {};
        CellPoller::Settings polling = {};
        std::chrono::milliseconds repetition = std::chrono::seconds(10); // of a list that does not change
        Report report;
    };

    explicit ModemFeed(Settings settings);
    ~ModemFeed();
    ModemFeed(const ModemFeed&) = delete;
    ModemFeed& operator=(const ModemFeed&) = delete;

    struct Callbacks {
        /// Is told the answer to "GetTechnology", empty while there is no modem.
        std::function<void(const std::string& technology)> technologyChanged;
        /// Called once, within a second: whether there is a modem is known, or cannot be known yet. Clients
        /// that are heard after that are not refused for coming first.
        std::function<void()> asked;
    };
    void start(Callbacks callbacks);
    /// Null while there is no modem.
    SourceFactory sourceFactory();
    /// Leaves the modem as it was found, then calls `done`.
    void finish(std::function<void()> done);

    // For the sources.
    void add(ModemSource& source);
    void remove(ModemSource& source);
    void handleWishes();
    /// A property list; empty while it is not known.
    const std::vector<std::byte>& list(std::uint32_t code) const { return lists[code - kSimFiles]; }
    std::chrono::milliseconds repetition() const { return settings.repetition; }

private:
    void update();
    void endQuestion();
    void choose();
    void updateTechnology();
    void updateLists();
    void reportState();

    Settings settings;
    Complaints complaints;
    ModemManagerClient client;
    ModemView view; // of the chosen modem
    Callbacks callbacks;
    std::string technology;
    std::string lastOnNetwork; // the technology that this modem was on
    QString modem;             // the chosen one's path
    std::unique_ptr<CellPoller> poller;
    std::set<ModemSource*> sources;
    std::array<std::vector<std::byte>, kCodes.size()> lists;
    bool polled = false;
    QObject lifetime; // of what waits for a timer
};

} // namespace pelorus
