#include "app/ElidedLabel.h"
#include "app/PelorusSaveViewController.h"
#include "app/Toolbar.h"
#include "tests/app/AppFixture.h"

#include <QLineEdit>
#include <QListWidget>
#include <QMessageBox>
#include <QPushButton>
#include <QToolButton>

namespace pelorus::test {
namespace {

using testing::ElementsAre;
using testing::IsEmpty;
using testing::SizeIs;

class SaveView : public AppFixture {
protected:
    SaveView()
    {
        platform.addFile("/data/BrindleInternal/Library/PreferenceBundles/Carrier Settings.bundle", "");
        start();
    }
    PelorusSaveViewController& screen() { return *app.getSaveViewController(); }
    void pressSave() { QTest::mouseClick(screen().findChild<QPushButton*>("saveButton"), Qt::LeftButton); }
    std::vector<std::string> rows()
    {
        std::vector<std::string> texts;
        const QListWidget* table = screen().saveContentTable();
        for (int row = 0; row < table->count(); ++row)
            texts.push_back(table->item(row)->text().toStdString() +
                            (table->item(row)->checkState() == Qt::Checked ? " [x]" : " [ ]"));
        return texts;
    }
    QString notice() { return app.navigationController()->toolbar().statusLabel().text(); }
    std::vector<std::string> keysOf(const Value& list)
    {
        std::vector<std::string> keys;
        for (const auto& entry : *list.dictionary())
            keys.emplace_back(entry.key.text());
        return keys;
    }
};

TEST_F(SaveView, ListsWhatIsSavedWithACheckMarkOnEveryRow)
{
    receive(makeDictionary({{"A", "1"}, {"B", "1"}}));
    receive(makeDictionary({{"A", "2"}, {"B", "1"}}));
    QTest::mouseClick(&app.navigationController()->toolbar().saveButton(), Qt::LeftButton);
    ASSERT_NE(app.getSaveViewController(), nullptr);
    EXPECT_THAT(rows(), ElementsAre("Snapshot (2024-05-01 11:45:07 +0000) [x]",
                                    "Snapshot (2024-05-01 11:45:09 +0000) [x]"));
    EXPECT_EQ(screen().saveContentTable()->font().family(), "Helvetica");
    EXPECT_EQ(screen().saveContentTable()->font().pixelSize(), 13);
    EXPECT_EQ(screen().size(), app.getWindow()->size());
}

TEST_F(SaveView, WritesWhatWasThereWhenItOpenedWithTheTimeOfThen)
{
    receive(makeDictionary({{"A", "1"}, {"B", "1"}}));
    app.showSaveView();
    receive(makeDictionary({{"A", "2"}, {"B", "1"}}));
    screen().saveDescription()->setText("In the lift");
    pressSave();
    platform.runMainQueue();
    EXPECT_EQ(app.getSaveViewController(), nullptr);
    ASSERT_THAT(platform.written, SizeIs(1));
    const auto& [path, content] = *platform.written.begin();
    EXPECT_EQ(path, "/crash-reports/PelorusSnapshot-1714563909.pelorus");
    EXPECT_THAT(keysOf(content), ElementsAre("Timestamp", "Data", "Description"));
    EXPECT_EQ(content.dictionary()->at("Timestamp"), Value("2024-05-01 11:45:07 +0000"));
    EXPECT_EQ(content.dictionary()->at("Description"), Value("In the lift"));
    const Value data = content.dictionary()->at("Data");
    ASSERT_THAT(data.array()->elements, SizeIs(1));
    EXPECT_EQ(data.array()->elements[0].dictionary()->at("Description"),
              Value("Snapshot (2024-05-01 11:45:07 +0000)"));
}

TEST_F(SaveView, WithoutADescriptionWritesAnEmptyOne)
{
    receive(makeDictionary({{"A", "1"}, {"B", "1"}}));
    app.showSaveView();
    pressSave();
    EXPECT_EQ(platform.written.begin()->second.dictionary()->at("Description"), Value(""));
}

TEST_F(SaveView, NamesTheFileInTheStatusLineForAWhile)
{
    receive(makeDictionary({{"A", "1"}, {"B", "1"}}));
    app.showSaveView();
    pressSave();
    platform.runMainQueue();
    EXPECT_EQ(notice(), "Saved PelorusSnapshot-1714563907.pelorus");
    EXPECT_EQ(status(), "Updated 2024-05-01 at 13:45:07");
    platform.advance(4s);
    EXPECT_EQ(notice(), "Saved PelorusSnapshot-1714563907.pelorus");
    platform.advance(1s);
    EXPECT_EQ(notice(), "Updated 2024-05-01 at 13:45:07");
}

TEST_F(SaveView, NamesTheFileBesideTheStatusWhileThereIsNoConnection)
{
    receive(makeDictionary({{"A", "1"}, {"B", "1"}}));
    app.showSaveView();
    pressSave();
    platform.runMainQueue();
    loseServer();
    EXPECT_EQ(notice(), "Connecting...  Saved PelorusSnapshot-1714563907.pelorus");
    platform.advance(4s);
    EXPECT_EQ(notice(), "Connecting...  Saved PelorusSnapshot-1714563907.pelorus");
    platform.advance(1s);
    EXPECT_EQ(notice(), "Connecting...");
}

TEST_F(SaveView, TellsWhenTheFileCannotBeWrittenAndClosesAllTheSame)
{
    platform.writesFail = true;
    log.take();
    app.showSaveView();
    pressSave();
    platform.runMainQueue();
    EXPECT_EQ(app.getSaveViewController(), nullptr);
    EXPECT_THAT(log.take(), ElementsAre("<3>Unable to write snapshot to "
                                        "/crash-reports/PelorusSnapshot-1714563905.pelorus"));
    auto* alert = app.getWindow()->findChild<QMessageBox*>();
    ASSERT_NE(alert, nullptr);
    EXPECT_TRUE(alert->isVisible());
    EXPECT_EQ(alert->windowTitle(), "File Error");
    EXPECT_EQ(alert->text(), "Unable to write file to disk");
    ASSERT_EQ(alert->buttons().size(), 1);
    EXPECT_EQ(alert->buttons().front()->text(), "Close");
    QTest::mouseClick(alert->buttons().front(), Qt::LeftButton);
    EXPECT_EQ(notice(), "Connecting...");
}

TEST_F(SaveView, WhoeverDescribesIsNotInterruptedBySectionsThatVanish)
{
    receive(makeDictionary({{"LTE", cell("7", "3")}, {"B", "1"}}));
    click(0);
    ASSERT_EQ(depth(), 2u);
    app.showSaveView();
    QApplication::setActiveWindow(app.getWindow());
    screen().saveDescription()->setFocus();
    ASSERT_TRUE(screen().saveDescription()->hasFocus());
    receive(makeDictionary({{"B", "1"}, {"C", "1"}}));
    EXPECT_EQ(depth(), 1u);
    EXPECT_TRUE(screen().saveDescription()->hasFocus());
    app.closeSaveView();
    EXPECT_TRUE(table().hasFocus());
}

TEST_F(SaveView, CancelWritesNothing)
{
    receive(makeDictionary({{"A", "1"}, {"B", "1"}}));
    app.showSaveView();
    QTest::mouseClick(screen().findChild<QPushButton*>("cancelButton"), Qt::LeftButton);
    EXPECT_NE(app.getSaveViewController(), nullptr) << "closed from the main queue";
    platform.runMainQueue();
    EXPECT_EQ(app.getSaveViewController(), nullptr);
    EXPECT_THAT(platform.written, IsEmpty());
    EXPECT_TRUE(app.navigationController()->isVisible());
}

TEST_F(SaveView, WithoutAGeneratorWritesOnlyTheTimestamp)
{
    app.applicationWillTerminate();
    platform.serverPresent = false;
    start();
    app.showSaveView();
    EXPECT_THAT(rows(), IsEmpty());
    pressSave();
    ASSERT_THAT(platform.written, SizeIs(1));
    EXPECT_THAT(keysOf(platform.written.begin()->second), ElementsAre("Timestamp"));
}

TEST_F(SaveView, IsOpenOnce)
{
    app.showSaveView();
    auto* first = &screen();
    app.showSaveView();
    EXPECT_EQ(&screen(), first);
    app.closeSaveView();
    app.closeSaveView();
    EXPECT_EQ(app.getSaveViewController(), nullptr);
}

TEST_F(SaveView, ReturnOnlyClosesTheKeyboard)
{
    receive(makeDictionary({{"A", "1"}, {"B", "1"}}));
    app.showSaveView();
    QApplication::setActiveWindow(app.getWindow());
    screen().saveDescription()->setFocus();
    ASSERT_TRUE(screen().saveDescription()->hasFocus());
    QTest::keyClick(screen().saveDescription(), Qt::Key_Return);
    platform.runMainQueue();
    EXPECT_FALSE(screen().saveDescription()->hasFocus());
    EXPECT_THAT(platform.written, IsEmpty());
    ASSERT_NE(app.getSaveViewController(), nullptr);

    screen().saveDescription()->setFocus();
    QTest::mouseClick(screen().saveContentTable()->viewport(), Qt::LeftButton, {}, {20, 10});
    EXPECT_FALSE(screen().saveDescription()->hasFocus());
    EXPECT_THAT(rows(), ElementsAre("Snapshot (2024-05-01 11:45:07 +0000) [x]"));

    screen().saveDescription()->setFocus();
    QTest::mouseClick(&screen(), Qt::LeftButton, {}, {100, 600});
    EXPECT_FALSE(screen().saveDescription()->hasFocus());
}

} // namespace
} // namespace pelorus::test
