#pragma once

#include "app/PelorusApp.h"
#include "app/PelorusPaneController.h"
#include "platform/PropertyList.h"
#include "platform/scripted/ScriptedPlatform.h"
#include "tests/support/RecordingLog.h"

#include <QApplication>
#include <QTest>
#include <gmock/gmock.h>

namespace pelorus::test {

using namespace std::chrono_literals;

class RecordingHomeScreen : public HomeScreenPreferences {
public:
    void setBoolean(const char* key, bool truth) override
    {
        written.push_back(std::string(key) + (truth ? "=true" : "=false"));
    }
    std::vector<std::string> written;
};

/// The application on a scripted machine. The baseband is one that sends its whole display, so a test says
/// what the tree is.
class AppFixture : public testing::Test {
protected:
    AppFixture()
    {
        platform.setNow(std::chrono::sys_days{2024y / 5 / 1} + 11h + 45min + 5s);
        platform.answerTechnology("IFX");
    }
    ~AppFixture() override { QTest::qWait(0); } // what is deleted later is deleted now

    void launch()
    {
        app.applicationDidFinishLaunching();
        app.getWindow()->resize(360, 640);
    }
    /// Launched, connected and no data yet.
    void start()
    {
        launch();
        platform.runMainQueue();
    }
    /// A message, and the refresh that shows it.
    void receive(const Value& display)
    {
        platform.deliver(serializePropertyList(display).value());
        platform.advance(2s);
        QTest::qWait(0);
    }
    PelorusPaneController& top() { return *app.navigationController()->topViewController(); }
    std::size_t depth() { return app.navigationController()->viewControllers().size(); }
    TableView& table() { return top().tableView(); }
    std::string status() { return top().toolbarItems().status; }
    bool isLoading() { return top().toolbarItems().indicatorRuns; }
    void click(int row) { QTest::mouseClick(table().viewport(), Qt::LeftButton, {}, centre(row)); }
    QPoint centre(int row) { return table().rectOfRow(row).center(); }
    void press(Qt::Key key, Qt::KeyboardModifiers modifiers = {})
    {
        QTest::keyClick(&table(), key, modifiers);
    }
    void loseServer()
    {
        platform.serverPresent = false;
        platform.breakPort(*platform.localPort());
        platform.runMainQueue();
    }
    /// What the rows in sight show, as "name: value" or "name >".
    std::vector<std::string> shown()
    {
        std::vector<std::string> rows;
        for (int row = 0; row < table().rowCount(); ++row)
            if (const PelorusCell* cell = table().cellOfRow(row))
                rows.push_back(cell->key().text().toStdString() +
                               (cell->value() ? ": " + cell->value()->text().toStdString() : " >"));
        return rows;
    }

    RecordingLog log;
    ScriptedPlatform platform;
    RecordingHomeScreen homeScreen;
    PelorusApp app{platform, homeScreen, "/data"};
};

inline Value cell(std::string_view id, std::string_view band)
{
    return makeDictionary({{"Cell ID", id}, {"Band", band}});
}

} // namespace pelorus::test
