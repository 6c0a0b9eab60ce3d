#include "tests/model/ModelFixture.h"

namespace pelorus::test {
namespace {

using testing::IsEmpty;

class Refresh : public ModelFixture {
protected:
    Refresh() { startWith("Osprey LTE"); }
};

TEST_F(Refresh, TwoMessagesGiveOneViewUpdate)
{
    platform.deliver(simFiles("1"));
    platform.deliver(simFiles("2"));
    EXPECT_EQ(observer.updates, 0);
    platform.advance(2s);
    EXPECT_EQ(observer.updates, 1);
    EXPECT_EQ(shownAt("/SIM Info/EF-ICCID"), "2");
}

TEST_F(Refresh, ViewUpdateIsDispatched)
{
    platform.deliver(simFiles("1"));
    model->refresh();
    EXPECT_EQ(observer.updates, 0);
    platform.runMainQueue();
    EXPECT_EQ(observer.updates, 1);
}

TEST_F(Refresh, WithoutNewsKeepsTheTreeAndUpdatesNoView)
{
    platform.deliver(simFiles("1"));
    platform.advance(2s);
    const auto tree = model->topLevelNodes();
    ASSERT_NE(tree, nullptr);
    platform.advance(10s);
    EXPECT_EQ(observer.updates, 1);
    EXPECT_EQ(model->topLevelNodes(), tree);
    EXPECT_EQ(model->nodeAtPath("/"), tree);
}

TEST_F(Refresh, WithNewsDropsTheTree)
{
    platform.deliver(simFiles("1"));
    platform.advance(2s);
    const auto tree = model->topLevelNodes();
    platform.deliver(simFiles("2"));
    EXPECT_EQ(model->topLevelNodes(), tree); // until the refresh
    platform.advance(2s);
    EXPECT_NE(model->topLevelNodes(), tree);
    EXPECT_EQ(observer.updates, 2);
}

TEST_F(Refresh, MessageOfAnotherIdChangesNothing)
{
    for (const std::int32_t id : {1, -1, 0x7FFFFFFF}) {
        EXPECT_TRUE(platform.deliver(simFiles("1"), id));
        EXPECT_EQ(platform.lastReply, std::nullopt);
    }
    platform.advance(10s);
    EXPECT_EQ(observer.updates, 0);
    EXPECT_THAT(log.take(), IsEmpty());
}

TEST_F(Refresh, LogMessageIsAnsweredWithNoData)
{
    platform.lastReply = Bytes();
    EXPECT_TRUE(platform.deliver(simFiles("1")));
    EXPECT_EQ(platform.lastReply, std::nullopt);
}

TEST_F(Refresh, EmptyMessageIsNewsToo)
{
    EXPECT_TRUE(platform.deliver(std::string_view()));
    platform.advance(2s);
    EXPECT_EQ(observer.updates, 1);
}

TEST_F(Refresh, BuildsTheTreeOncePerCycle)
{
    platform.deliver(simFiles("1"));
    platform.advance(2s);
    model->nodeAtPath("/SIM Info");
    model->topLevelNodes();
    model->nodeAtPath("/");
    EXPECT_EQ(model->getSaveContents()->elements.size(), 2U); // one history entry, and the DLF file
}

TEST_F(Refresh, PathThatIsNoMoreIsFoundNoMore)
{
    platform.deliver(simFiles("1"));
    platform.advance(2s);
    EXPECT_NE(model->nodeAtPath("/SIM Info/EF-ICCID"), nullptr);

    platform.answerTechnology("Osprey UTRAN2"); // drops the LTE display, and has none of its own
    model->restartMonitor();
    platform.deliver(simFiles("1"));
    platform.advance(2s);
    EXPECT_EQ(model->nodeAtPath("/SIM Info/EF-ICCID"), nullptr);
    EXPECT_EQ(shownAt("/"), "(unknown)");
}

TEST(RefreshWithoutAGenerator, HasNoTreeAndNoSaveContents)
{
    ScriptedPlatform platform;
    CountingObserver observer;
    PelorusModel model(platform, observer);
    EXPECT_EQ(model.topLevelNodes(), nullptr);
    EXPECT_EQ(model.nodeAtPath("/"), nullptr);
    EXPECT_EQ(model.getSaveContents(), nullptr);
    model.refresh();
    platform.runMainQueue();
    EXPECT_EQ(observer.updates, 0);
}

TEST(RefreshWithoutAGenerator, AnnouncesAMessageThatNobodyDecoded)
{
    ScriptedPlatform platform;
    CountingObserver observer;
    PelorusModel model(platform, observer);
    model.updateWithData({});
    model.refresh();
    platform.runMainQueue();
    EXPECT_EQ(observer.updates, 1);
}

} // namespace
} // namespace pelorus::test
