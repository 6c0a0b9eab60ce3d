#include "telephonyd/server/MessageStream.h"

#include "tests/support/PacketBuilder.h"

#include <gmock/gmock.h>

namespace pelorus::test {

namespace {

using namespace std::chrono_literals;
using Wait = MessageStream::Wait;

/// Messages of one byte of meaning, the last of 14.
struct Scripted {
    std::chrono::nanoseconds time;
    unsigned code;
    unsigned mark;
};

class ScriptedSource : public MessageSource {
public:
    explicit ScriptedSource(std::vector<Scripted> script) : script(std::move(script)) {}

    bool next(SourceMessage& message) override
    {
        if (place == script.size())
            return false;
        const Scripted& line = script[place++];
        bytes = PacketBuilder(14).u8(0, 1).u16(3, line.code).u8(13, line.mark).bytes();
        message = {line.time, bytes};
        return true;
    }
    bool rewind() override
    {
        place = 0;
        return canRewind;
    }

    bool canRewind = true;

private:
    std::vector<Scripted> script;
    std::size_t place = 0;
    std::vector<std::byte> bytes;
};

class ListSink : public MessageSink {
public:
    bool hasRoom(std::size_t) const override { return marks.size() < room; }
    void send(std::span<const std::byte> message) override
    {
        marks.push_back(std::to_integer<int>(message[13]));
    }

    std::vector<int> marks;
    std::size_t room = 1000000;
};

Subscription subscriptionTo(std::vector<Value> codes)
{
    std::string why;
    return *Subscription::fromStartCommand(
        makeDictionary({{"SetState", "Streaming"}, {"SetOspreyLogCodes", makeArray(std::move(codes))}}), why);
}

MessageStream streamOf(std::vector<Scripted> script, Pace pace, bool loop = false)
{
    return {std::make_unique<ScriptedSource>(std::move(script)), pace, loop};
}

using testing::ElementsAre;
using testing::IsEmpty;

} // namespace

TEST(MessageStream, SendsWhatIsDueAndTellsWhenTheNextIs)
{
    MessageStream stream = streamOf({{50s, 7, 1}, {51s, 7, 2}, {51s, 7, 3}, {60s, 7, 4}}, Pace::ownTiming(1));
    stream.subscribe(subscriptionTo({7}));
    ListSink sink;
    MessageStream::Pause pause = stream.run(0s, sink);
    EXPECT_THAT(sink.marks, ElementsAre(1));
    EXPECT_EQ(pause.wait, Wait::untilDue);
    EXPECT_EQ(pause.due, 1s);

    stream.run(999ms, sink);
    EXPECT_THAT(sink.marks, ElementsAre(1));
    stream.run(1s, sink);
    EXPECT_THAT(sink.marks, ElementsAre(1, 2, 3));
    pause = stream.run(10s, sink);
    EXPECT_THAT(sink.marks, ElementsAre(1, 2, 3, 4));
    EXPECT_EQ(pause.wait, Wait::atEnd);
}

TEST(MessageStream, SendsOnlyWhatIsSubscribedTo)
{
    MessageStream stream = streamOf({{0s, 7, 1}, {1s, 8, 2}, {2s, 9, 3}, {3s, 7, 4}}, Pace::ownTiming(1));
    stream.subscribe(subscriptionTo({7, 9}));
    ListSink sink;
    EXPECT_EQ(stream.run(1s, sink).due, 2s); // what is passed over keeps its time
    stream.run(100s, sink);
    EXPECT_THAT(sink.marks, ElementsAre(1, 3, 4));
}

TEST(MessageStream, SendsNothingWithoutASubscription)
{
    MessageStream stream = streamOf({{0s, 7, 1}}, Pace::ownTiming(1));
    ListSink sink;
    EXPECT_EQ(stream.run(100s, sink).wait, Wait::atEnd);
    EXPECT_THAT(sink.marks, IsEmpty());
}

TEST(MessageStream, ANewSubscriptionReplacesTheOldOneAlsoForTheMessageThatWaits)
{
    MessageStream stream = streamOf({{0s, 7, 1}, {5s, 7, 2}, {6s, 8, 3}}, Pace::ownTiming(1));
    stream.subscribe(subscriptionTo({7}));
    ListSink sink;
    stream.run(0s, sink);
    stream.subscribe(subscriptionTo({8}));
    stream.run(100s, sink);
    EXPECT_THAT(sink.marks, ElementsAre(1, 3));
}

TEST(MessageStream, WaitsForRoomAndLosesNothing)
{
    MessageStream stream = streamOf({{0s, 7, 1}, {0s, 7, 2}, {0s, 7, 3}}, Pace::ownTiming(1));
    stream.subscribe(subscriptionTo({7}));
    ListSink sink;
    sink.room = 1;
    EXPECT_EQ(stream.run(0s, sink).wait, Wait::forRoom);
    EXPECT_EQ(stream.run(50s, sink).wait, Wait::forRoom);
    EXPECT_THAT(sink.marks, ElementsAre(1));
    sink.room = 10;
    EXPECT_EQ(stream.run(50s, sink).wait, Wait::atEnd);
    EXPECT_THAT(sink.marks, ElementsAre(1, 2, 3));
}

TEST(MessageStream, PlaysEverythingAtOnceAtSpeed0)
{
    MessageStream stream = streamOf({{0s, 7, 1}, {1h, 7, 2}, {2h, 7, 3}}, Pace::ownTiming(0));
    stream.subscribe(subscriptionTo({7}));
    ListSink sink;
    EXPECT_EQ(stream.run(0s, sink).wait, Wait::atEnd);
    EXPECT_THAT(sink.marks, ElementsAre(1, 2, 3));
}

TEST(MessageStream, LoopsWithItsTiming)
{
    MessageStream stream = streamOf({{10s, 7, 1}, {12s, 7, 2}}, Pace::ownTiming(1), true);
    stream.subscribe(subscriptionTo({7}));
    ListSink sink;
    stream.run(2s, sink);
    EXPECT_THAT(sink.marks, ElementsAre(1, 2, 1));
    stream.run(4s, sink);
    EXPECT_THAT(sink.marks, ElementsAre(1, 2, 1, 2, 1));
}

TEST(MessageStream, ALoopGivesOthersTheirTurn)
{
    MessageStream stream = streamOf({{0s, 7, 1}}, Pace::ownTiming(0), true);
    stream.subscribe(subscriptionTo({7}));
    ListSink sink;
    EXPECT_EQ(stream.run(0s, sink).wait, Wait::forTurn);
    const std::size_t sent = sink.marks.size();
    EXPECT_GT(sent, 1000U);
    EXPECT_EQ(stream.run(0s, sink).wait, Wait::forTurn);
    EXPECT_GT(sink.marks.size(), sent);
}

TEST(MessageStream, ALoopWithNothingToSendEnds)
{
    MessageStream stream = streamOf({{0s, 7, 1}}, Pace::ownTiming(1), true);
    stream.subscribe(subscriptionTo({8}));
    ListSink sink;
    EXPECT_EQ(stream.run(0s, sink).wait, Wait::atEnd);
    EXPECT_EQ(stream.run(100s, sink).wait, Wait::atEnd);

    MessageStream empty = streamOf({}, Pace::ownTiming(0), true);
    empty.subscribe(subscriptionTo({8}));
    EXPECT_EQ(empty.run(0s, sink).wait, Wait::atEnd);
    EXPECT_THAT(sink.marks, IsEmpty());
}

TEST(MessageStream, ALoopThatHadNothingToSendGoesOnWithAnotherSubscription)
{
    MessageStream stream = streamOf({{0s, 7, 1}}, Pace::ownTiming(0), true);
    stream.subscribe(subscriptionTo({8}));
    ListSink sink;
    stream.run(0s, sink);
    stream.subscribe(subscriptionTo({7}));
    stream.run(0s, sink);
    EXPECT_FALSE(sink.marks.empty());
}

TEST(MessageStream, SendsAtARate)
{
    std::vector<Scripted> script;
    for (unsigned i = 0; i < 100; ++i)
        script.push_back({std::chrono::hours(i), i % 2, i});
    MessageStream stream = streamOf(script, Pace::rate(10));
    stream.subscribe(subscriptionTo({1}));
    ListSink sink;
    EXPECT_EQ(stream.run(350ms, sink).due, 400ms);
    EXPECT_THAT(sink.marks, ElementsAre(1, 3, 5, 7));
}

TEST(MessageStream, OfAnEndlessSourceWaitsForMoreInsteadOfEnding)
{
    class Endless : public ScriptedSource {
    public:
        using ScriptedSource::ScriptedSource;
        bool awaitMore(std::function<void()> callback) override
        {
            more = std::move(callback);
            return true;
        }
        void subscribe(const Subscription& wanted) override { wantsFirst = wanted.wants(0x0001); }
        std::function<void()> more;
        bool wantsFirst = false;
    };
    auto owned = std::make_unique<Endless>(std::vector<Scripted>{{0s, 0x0001, 1}});
    Endless& source = *owned;
    MessageStream stream(std::move(owned), Pace::ownTiming(0), false);
    ListSink sink;
    int woken = 0;
    stream.onMore([&] { ++woken; });
    stream.subscribe(subscriptionTo({1}));
    EXPECT_TRUE(source.wantsFirst);
    EXPECT_EQ(stream.run(0s, sink).wait, Wait::forMore);
    source.more();
    EXPECT_EQ(woken, 1);
    source.rewind(); // it has something again
    EXPECT_EQ(stream.run(3s, sink).wait, Wait::forMore);
    EXPECT_THAT(sink.marks, testing::ElementsAre(1, 1));
}

} // namespace pelorus::test
