#include "app/PelorusSaveViewController.h"
#include "app/Toolbar.h"
#include "tests/app/AppFixture.h"

namespace pelorus::test {
namespace {

using testing::ElementsAre;
using testing::IsEmpty;

TEST_F(AppFixture, BeforeTheWindowIsShownTheRootPaneSaysConnectingWithoutDots)
{
    struct Host : PaneHost {
        bool allowSaveButton() const override { return false; }
        void showSaveView() override {}
    } host;
    PelorusPaneController root(nullptr, "/", host);
    EXPECT_EQ(root.path(), "/");
    EXPECT_EQ(root.title(), "Pelorus");
    EXPECT_EQ(root.numberOfRowsInSection(), 0);
    EXPECT_EQ(root.toolbarItems(), (ToolbarItems{true, "", false}));
    root.setStatus("Connecting", true);
    EXPECT_EQ(root.toolbarItems(), (ToolbarItems{true, "Connecting", false}));
}

TEST_F(AppFixture, TheMonitorStartsAfterLaunchReturns)
{
    launch();
    EXPECT_THAT(platform.calls, IsEmpty());
    EXPECT_EQ(depth(), 1u);
    EXPECT_EQ(top().title(), "Pelorus");
    EXPECT_EQ(table().rowCount(), 0);
    EXPECT_EQ(status(), "Connecting...");
    EXPECT_TRUE(isLoading());
    EXPECT_TRUE(app.getWindow()->isVisible());
    platform.runMainQueue();
    EXPECT_TRUE(app.getModel()->isConnected());
}

TEST_F(AppFixture, ConnectedWithoutDataItShowsTheLastMessageAndNoIndicator)
{
    start();
    EXPECT_EQ(status(), "Connecting..."); // what the update message is until there is an update
    EXPECT_FALSE(isLoading());
}

TEST_F(AppFixture, AnUpdateShowsTheTreeAndItsLocalTime)
{
    start();
    receive(makeDictionary({{"Serving", cell("7", "3")}, {"State", "Idle"}}));
    EXPECT_THAT(shown(), ElementsAre("Serving >", "State: Idle"));
    EXPECT_EQ(status(), "Updated 2024-05-01 at 13:45:07");
    EXPECT_FALSE(isLoading());
    platform.advance(10s);
    EXPECT_EQ(status(), "Updated 2024-05-01 at 13:45:07") << "nothing new, no update";
}

TEST_F(AppFixture, TapsDrillDownAndEveryPaneIsRefreshed)
{
    start();
    receive(makeDictionary(
        {{"LTE", makeDictionary({{"Serving", cell("7", "3")}, {"State", "Idle"}})}, {"A", "1"}}));
    click(0);
    EXPECT_EQ(top().path(), "/LTE");
    EXPECT_EQ(top().title(), "LTE");
    EXPECT_EQ(status(), "Updated 2024-05-01 at 13:45:07");
    click(0);
    EXPECT_EQ(top().path(), "/LTE/Serving");
    EXPECT_EQ(depth(), 3u);
    EXPECT_THAT(shown(), ElementsAre("Cell ID: 7", "Band: 3"));
    receive(makeDictionary(
        {{"LTE", makeDictionary({{"Serving", cell("8", "20")}, {"State", "Camped"}})}, {"A", "2"}}));
    EXPECT_EQ(depth(), 3u);
    EXPECT_THAT(shown(), ElementsAre("Cell ID: 8", "Band: 20"));
    EXPECT_EQ(status(), "Updated 2024-05-01 at 13:45:09");
    press(Qt::Key_Backspace);
    EXPECT_EQ(top().path(), "/LTE");
    EXPECT_THAT(shown(), ElementsAre("Serving >", "State: Camped"));
    EXPECT_EQ(status(), "Updated 2024-05-01 at 13:45:09");
    press(Qt::Key_Left, Qt::AltModifier);
    EXPECT_THAT(shown(), ElementsAre("LTE >", "A: 2"));
    press(Qt::Key_Backspace);
    EXPECT_EQ(depth(), 1u);
}

TEST_F(AppFixture, ASectionThatVanishesPopsToItsParentWhichIsReloaded)
{
    start();
    const auto with = [](const Value& serving) {
        return makeDictionary(
            {{"LTE", makeDictionary({{"Serving", serving}, {"State", "Idle"}})}, {"A", "1"}});
    };
    receive(with(makeDictionary({{"Cells", cell("1", "2")}, {"B", "1"}})));
    click(0);
    click(0);
    click(0);
    ASSERT_EQ(top().path(), "/LTE/Serving/Cells");
    receive(makeDictionary({{"LTE", makeDictionary({{"State", "Searching"}, {"C", "1"}})}, {"A", "1"}}));
    EXPECT_EQ(depth(), 2u);
    EXPECT_EQ(top().path(), "/LTE");
    EXPECT_THAT(shown(), ElementsAre("State: Searching", "C: 1"));
}

TEST_F(AppFixture, LosingTheServerShowsConnectingAtOnceAndKeepsTheRowsAndTheLastMessage)
{
    start();
    receive(makeDictionary({{"LTE", cell("7", "3")}, {"A", "1"}}));
    click(0);
    loseServer();
    EXPECT_EQ(status(), "Connecting...");
    EXPECT_TRUE(isLoading());
    EXPECT_THAT(shown(), ElementsAre("Cell ID: 7", "Band: 3"));
    EXPECT_EQ(app.getUpdateMessage(), "Updated 2024-05-01 at 13:45:07");
    press(Qt::Key_Backspace);
    EXPECT_EQ(status(), "Connecting...");
    click(0);
    EXPECT_EQ(status(), "Connecting...");
    EXPECT_TRUE(isLoading());
    platform.serverPresent = true;
    platform.advance(5s);
    EXPECT_EQ(status(), "Updated 2024-05-01 at 13:45:07");
    EXPECT_FALSE(isLoading());
    EXPECT_EQ(top().path(), "/LTE");
}

TEST_F(AppFixture, OffersSaveOnlyOnInternalBuilds)
{
    start();
    EXPECT_FALSE(top().toolbarItems().offersSave);
    press(Qt::Key_S, Qt::ControlModifier);
    EXPECT_EQ(app.getSaveViewController(), nullptr);
}

TEST_F(AppFixture, KnowsAnInternalBuildByItsMarker)
{
    platform.addFile("/BrindleInternal/Library/PreferenceBundles/Carrier Settings.bundle", "");
    start();
    EXPECT_TRUE(top().toolbarItems().offersSave);
}

TEST_F(AppFixture, KnowsAnInternalBuildByTheMarkerInItsData)
{
    platform.addFile("/data/BrindleInternal/Library/PreferenceBundles/Carrier Settings.bundle", "");
    start();
    EXPECT_TRUE(top().toolbarItems().offersSave);
    receive(makeDictionary({{"LTE", cell("7", "3")}, {"A", "1"}}));
    click(0);
    EXPECT_TRUE(top().toolbarItems().offersSave);
}

TEST_F(AppFixture, AtItsEndTheHomeScreenShowsNoNumbersAndNothingIsLeftOpen)
{
    start();
    EXPECT_THAT(homeScreen.written, IsEmpty());
    app.applicationWillTerminate();
    EXPECT_THAT(homeScreen.written, ElementsAre("HBShowGSMRSSI=false"));
    EXPECT_EQ(app.getModel(), nullptr);
    EXPECT_EQ(app.getWindow(), nullptr);
    EXPECT_EQ(app.getUpdateMessage(), "");
    EXPECT_EQ(platform.localPort(), nullptr);
    EXPECT_EQ(platform.repeatingTimers(), 0u);
}

TEST_F(AppFixture, EndsBeforeTheMonitorHasStarted)
{
    launch();
    app.applicationWillTerminate();
    platform.advance(10s);
    EXPECT_THAT(platform.calls, IsEmpty());
}

} // namespace
} // namespace pelorus::test
