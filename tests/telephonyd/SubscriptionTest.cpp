#include "telephonyd/server/Subscription.h"

#include "telephonyd/server/LogMessage.h"
#include "tests/support/PacketBuilder.h"

#include <gtest/gtest.h>

namespace pelorus::test {

namespace {

Value commandOf(std::vector<Value> basebandCodes, std::vector<Value> serverCodes)
{
    return makeDictionary({{"SetState", "Streaming"},
                           {"SetOspreyLogCodes", makeArray(std::move(basebandCodes))},
                           {"SetCtExtraCodes", makeArray(std::move(serverCodes))}});
}

std::vector<std::byte> message(unsigned type, unsigned code, std::size_t length = 13)
{
    return PacketBuilder(length).u8(0, type).u16(3, code).length(length).bytes();
}

std::vector<std::byte> prefixed(unsigned type, unsigned code)
{
    return PacketBuilder(15).u8(0, 0x81).u8(2, type).u16(5, code).bytes();
}

} // namespace

TEST(Subscription, WantsTheCodesOfTheStartCommandAndNoOthers)
{
    std::string why;
    const auto wanted = Subscription::fromStartCommand(commandOf({45433, 45439}, {0, 2}), why);
    ASSERT_TRUE(wanted) << why;
    EXPECT_TRUE(wanted->wants(message(1, 0xB179)));
    EXPECT_TRUE(wanted->wants(message(1, 0xB17F)));
    EXPECT_FALSE(wanted->wants(message(1, 0xB180)));
    EXPECT_TRUE(wanted->wants(message(0xFF, 0)));
    EXPECT_FALSE(wanted->wants(message(0xFF, 1)));
    EXPECT_TRUE(wanted->wants(message(0xFF, 2)));
    EXPECT_FALSE(wanted->wants(message(1, 2)));         // 0x0002 is not 0xFF0002
    EXPECT_FALSE(wanted->wants(message(0xFF, 0xB179))); // nor is 0xFFB179 0xB179
}

TEST(Subscription, ReadsCodesBehindAPrefix)
{
    std::string why;
    const auto wanted = Subscription::fromStartCommand(commandOf({0xB179}, {1}), why);
    EXPECT_TRUE(wanted->wants(prefixed(1, 0xB179)));
    EXPECT_TRUE(wanted->wants(prefixed(0xFF, 1)));
    EXPECT_FALSE(wanted->wants(prefixed(2, 0xB179)));
    EXPECT_FALSE(wanted->wants(prefixed(0x81, 0xB179))); // one prefix, not two
}

TEST(Subscription, DoesNotWantMessagesWithoutAReadableCode)
{
    std::string why;
    std::vector<Value> all;
    for (int code = 0; code < 0x10000; ++code)
        all.emplace_back(code);
    const auto wanted = Subscription::fromStartCommand(commandOf(all, all), why);
    ASSERT_TRUE(wanted);
    EXPECT_TRUE(wanted->wants(message(1, 0)));
    for (std::size_t length = 0; length < 13; ++length)
        EXPECT_FALSE(wanted->wants(message(1, 0xB179, length))) << length;
    EXPECT_FALSE(wanted->wants(message(0, 0xB179)));
    EXPECT_FALSE(wanted->wants(message(2, 0xB179)));
    EXPECT_FALSE(wanted->wants(message(0xFE, 0xB179)));
}

TEST(Subscription, ToEverythingWantsWhatHasNoCodeToo)
{
    EXPECT_TRUE(Subscription::toEverything().wants(message(0, 0, 3)));
    EXPECT_TRUE(Subscription::toEverything().wants({}));
}

TEST(Subscription, TakesAStartCommandWithoutCodes)
{
    std::string why;
    const auto none = Subscription::fromStartCommand(makeDictionary({{"SetState", "Streaming"}}), why);
    ASSERT_TRUE(none);
    EXPECT_FALSE(none->wants(message(1, 0xB179)));
    EXPECT_TRUE(Subscription::fromStartCommand(commandOf({}, {}), why));
}

TEST(Subscription, RefusesWhatIsNoStartCommand)
{
    const std::pair<Value, const char*> cases[] = {
        {makeArray({}), "a command without \"SetState\""},
        {makeDictionary({{"State", "Streaming"}}), "a command without \"SetState\""},
        {makeDictionary({{"SetState", 1}}), "a command without \"SetState\""},
        {makeDictionary({{"SetState", "Idle"}}), "a \"SetState\" that is not \"Streaming\""},
        {makeDictionary({{"SetState", "Streaming"}, {"SetOspreyLogCodes", 45433}}),
         "a start command that cannot be followed: its \"SetOspreyLogCodes\" is no array"},
        {commandOf({0x10000}, {}),
         "a start command that cannot be followed: its \"SetOspreyLogCodes\" holds something that is no log "
         "code"},
        {commandOf({}, {-1}),
         "a start command that cannot be followed: its \"SetCtExtraCodes\" holds something that is no log "
         "code"},
        {commandOf({}, {"1"}),
         "a start command that cannot be followed: its \"SetCtExtraCodes\" holds something that is no log "
         "code"},
    };
    for (const auto& [command, reason] : cases) {
        std::string why;
        EXPECT_FALSE(Subscription::fromStartCommand(command, why));
        EXPECT_EQ(why, reason);
    }
}

TEST(Subscription, CountsInItsDescription)
{
    std::string why;
    EXPECT_EQ(Subscription::fromStartCommand(commandOf({1, 2, 2}, {0}), why)->description(),
              "2 log codes and 1 of the server's own");
    EXPECT_EQ(Subscription::toEverything().description(), "everything");
}

} // namespace pelorus::test
