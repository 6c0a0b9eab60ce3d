#include "app/ActivityIndicator.h"
#include "app/ElidedLabel.h"
#include "app/TitleBar.h"
#include "app/Toolbar.h"
#include "tests/app/AppFixture.h"
#include "tests/app/TestStyle.h"

#include <QSettings>
#include <QToolButton>

namespace pelorus::test {
namespace {

class Navigation : public AppFixture {
protected:
    Navigation()
    {
        start();
        receive(
            makeDictionary({{"LTE", makeDictionary({{"Serving", cell("7", "3")}, {"A", "1"}})}, {"B", "1"}}));
    }
    ~Navigation() override { TestStyle::duration = 0; }
    TitleBar& titleBar() { return app.navigationController()->titleBar(); }
    Toolbar& toolbar() { return app.navigationController()->toolbar(); }
};

TEST_F(Navigation, TheTitleBarNamesThePaneAndTheWayBack)
{
    EXPECT_EQ(titleBar().title(), "Pelorus");
    EXPECT_FALSE(titleBar().backButton().isVisible());
    click(0);
    EXPECT_EQ(titleBar().title(), "LTE");
    EXPECT_EQ(app.getWindow()->windowTitle(), "LTE");
    EXPECT_TRUE(titleBar().backButton().isVisible());
    EXPECT_EQ(titleBar().backButton().text(), "Pelorus");
    EXPECT_EQ(titleBar().backButton().accessibleName(), "Back to Pelorus");
    QTest::mouseClick(&titleBar().backButton(), Qt::LeftButton);
    EXPECT_EQ(titleBar().title(), "Pelorus");
    EXPECT_FALSE(titleBar().backButton().isVisible());
}

TEST_F(Navigation, TheWayBackIsAnArrowWhereThereIsNoRoomForItsName)
{
    const auto inner = makeDictionary({{"A name that is long", cell("7", "3")}, {"B", "1"}});
    receive(makeDictionary({{"Another name that is long", inner}, {"B", "1"}}));
    click(0);
    click(0);
    ASSERT_EQ(titleBar().title(), "A name that is long");
    app.getWindow()->resize(600, 640);
    EXPECT_EQ(titleBar().backButton().toolButtonStyle(), Qt::ToolButtonTextBesideIcon);
    app.getWindow()->resize(320, 480);
    EXPECT_EQ(titleBar().backButton().toolButtonStyle(), Qt::ToolButtonIconOnly);
    EXPECT_EQ(titleBar().backButton().accessibleName(), "Back to Another name that is long");
    EXPECT_LT(titleBar().backButton().geometry().right(), 48);
}

TEST_F(Navigation, TheWayBackShowsAnyNameAsItIs)
{
    const auto backFrom = [this](const std::string& name) -> QToolButton& {
        const auto inner = makeDictionary({{"In", cell("7", "3")}, {"B", "1"}});
        receive(makeDictionary({{name, inner}, {"B", "1"}}));
        click(0);
        click(0);
        EXPECT_EQ(titleBar().title(), "In");
        return titleBar().backButton();
    };
    const QToolButton& button = backFrom("A && B &C");
    EXPECT_EQ(button.text(), "A &&&& B &&C") << "none of them marks a key";
    EXPECT_TRUE(button.shortcut().isEmpty());
    receive(makeDictionary({{"B", "1"}, {"C", "1"}}));
    EXPECT_EQ(backFrom("A\nB").text(), "A B");
    receive(makeDictionary({{"B", "1"}, {"C", "1"}}));
    EXPECT_EQ(backFrom("<b>A</b>").text(), "<b>A</b>");
    EXPECT_TRUE(button.toolTip().contains("&lt;b&gt;A&lt;/b&gt;"));
}

TEST_F(Navigation, ThereIsAWayBackToASectionWithoutAName)
{
    const auto inner = makeDictionary({{"In", cell("7", "3")}, {"B", "1"}});
    receive(makeDictionary({{"", inner}, {"B", "1"}}));
    click(0);
    click(0);
    EXPECT_EQ(titleBar().title(), "In");
    EXPECT_TRUE(titleBar().backButton().isVisible());
}

TEST_F(Navigation, TheToolbarShowsIndicatorStatusAndSaveFromTheLeft)
{
    EXPECT_FALSE(toolbar().indicator().isVisible());
    EXPECT_EQ(toolbar().statusLabel().text(), "Updated 2024-05-01 at 13:45:07");
    EXPECT_EQ(toolbar().statusLabel().font().pixelSize(), 14);
    EXPECT_FALSE(toolbar().statusLabel().font().bold());
    EXPECT_EQ(toolbar().statusLabel().width(), toolbar().statusLabel().sizeHint().width()) << "fits its text";
    EXPECT_FALSE(toolbar().saveButton().isVisible());
    loseServer();
    EXPECT_TRUE(toolbar().indicator().isVisible());
    EXPECT_EQ(toolbar().statusLabel().text(), "Connecting...");
    EXPECT_LT(toolbar().indicator().geometry().right(), toolbar().statusLabel().geometry().left());
}

TEST_F(Navigation, EverythingFitsIntoTheSmallestWindow)
{
    platform.addFile("/data/BrindleInternal/Library/PreferenceBundles/Carrier Settings.bundle", "");
    app.getSaveButtonPref();
    receive(makeDictionary({{"A", "1"}, {"B", "1"}}));
    app.getWindow()->resize(10, 10);
    EXPECT_EQ(app.getWindow()->size(), QSize(320, 480));
    EXPECT_EQ(toolbar().statusLabel().width(), toolbar().statusLabel().sizeHint().width());
    EXPECT_LE(toolbar().saveButton().geometry().right(), 310);
    EXPECT_EQ(app.navigationController()->geometry(), QRect(0, 0, 320, 480));
}

TEST_F(Navigation, PanesSlideWhereTheDesktopWantsMotion)
{
    TestStyle::duration = 100;
    PelorusPaneController& root = top();
    click(0);
    EXPECT_EQ(depth(), 2u) << "the stack changes at once";
    PelorusPaneController& pane = top();
    EXPECT_GT(pane.x(), 180);
    EXPECT_TRUE(root.isVisible());
    ASSERT_TRUE(QTest::qWaitFor([&] { return !root.isVisible(); }, 2000));
    EXPECT_EQ(pane.x(), 0);
    const QPointer<PelorusPaneController> leaving = &pane;
    press(Qt::Key_Backspace);
    EXPECT_EQ(&top(), &root);
    EXPECT_TRUE(root.isVisible());
    ASSERT_TRUE(QTest::qWaitFor([&] { return !leaving; }, 2000));
    EXPECT_EQ(root.x(), 0);
    EXPECT_TRUE(root.isVisible());
}

TEST_F(Navigation, PanesThatComeAndGoQuicklyEndUpInTheirPlace)
{
    TestStyle::duration = 60;
    click(0);
    press(Qt::Key_Down);
    press(Qt::Key_Return);
    EXPECT_EQ(depth(), 3u);
    press(Qt::Key_Backspace);
    press(Qt::Key_Backspace);
    press(Qt::Key_Home);
    press(Qt::Key_Return);
    EXPECT_EQ(depth(), 2u);
    app.getWindow()->resize(500, 700);
    QTest::qWait(300);
    EXPECT_EQ(top().geometry(), QRect(0, 0, 500, 700 - 2 * 48));
    EXPECT_TRUE(top().isVisible());
    EXPECT_FALSE(app.navigationController()->viewControllers().front()->isVisible());
    EXPECT_EQ(app.navigationController()->findChildren<TableView*>().size(), 2);
}

TEST_F(Navigation, TheWindowRemembersItsPlace)
{
    app.getWindow()->resize(400, 600);
    app.applicationWillTerminate();
    app.applicationDidFinishLaunching();
    EXPECT_EQ(app.getWindow()->size(), QSize(400, 600));
    QSettings().clear();
}

} // namespace
} // namespace pelorus::test
