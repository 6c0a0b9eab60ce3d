#include "tests/generator/ProbeFixture.h"

namespace pelorus::test {
namespace {

class RawMessages : public ProbeFixture {
protected:
    void receive(const PacketBuilder& message)
    {
        expected.insert(expected.end(), message.bytes().begin(), message.bytes().end());
        generator.updateState(state, message.bytes());
    }
    Bytes expected;
};

TEST_F(RawMessages, AreHandedOverAsReceived)
{
    receive(packet(1, 0x1234));
    receive(PacketBuilder(2).u8(0, 0x81).u8(1, 0x05).raw(packet(1, 0x1234).bytes())); // prefix included
    receive(PacketBuilder(5).u8(0, 1));                                               // too short to decode
    receive(packet(9, 0x1234));                                                       // of no known type
    EXPECT_FALSE(state.find("DisplayState"));
    generator.generateLogUsingState(state);
    EXPECT_EQ(state.at("DisplayState"), Value(makeData(expected)));
}

TEST_F(RawMessages, AreThoseSinceTheGenerationBefore)
{
    receive(packet(1, 0x1234));
    generator.generateLogUsingState(state);
    expected.clear();
    receive(packet(1, 0x0001));
    generator.generateLogUsingState(state);
    EXPECT_EQ(state.at("DisplayState"), Value(makeData(expected)));
    generator.generateLogUsingState(state);
    EXPECT_EQ(state.at("DisplayState"), Value(makeData({})));

    const auto& history = state.at("History").array()->elements;
    ASSERT_EQ(history.size(), 3U);
    EXPECT_EQ(history[0].dictionary()->at("DisplayState"), Value(makeData(packet(1, 0x1234).bytes())));
    EXPECT_EQ(history[1].dictionary()->at("DisplayState"), Value(makeData(packet(1, 0x0001).bytes())));
    EXPECT_EQ(history[2].dictionary()->at("DisplayState"), Value(makeData({})));
}

TEST_F(RawMessages, AreDroppedForWhoSavesNothing)
{
    generator.dropRawMessages();
    receive(packet(1, 0x1234));
    generator.generateLogUsingState(state);
    EXPECT_EQ(state.at("DisplayState"), Value(makeData({})));
}

TEST_F(RawMessages, StayAsTheyWereForWhoHoldsThem)
{
    constexpr unsigned kRounds = 12; // more than the history keeps, so that memory is used again
    std::vector<Value> held;
    for (unsigned round = 0; round < kRounds; ++round) {
        receive(packet(1, 0x0100 + round));
        generator.generateLogUsingState(state);
        if (round % 2 == 0)
            held.push_back(state.at("DisplayState"));
    }
    for (unsigned round = 0; round < kRounds; round += 2)
        EXPECT_EQ(held[round / 2], Value(makeData(packet(1, 0x0100 + round).bytes()))) << round;
    const auto& history = state.at("History").array()->elements;
    ASSERT_EQ(history.size(), 5U);
    for (unsigned entry = 0; entry < 5; ++entry)
        EXPECT_EQ(history[entry].dictionary()->at("DisplayState"),
                  Value(makeData(packet(1, 0x0100 + kRounds - 5 + entry).bytes())))
            << entry;
}

TEST_F(RawMessages, IncludeTheOneThatEndsTheProgram)
{
    index->first->throws = true;
    EXPECT_THROW(receive(packet(1, 0x1234)), ArrayOutOfBoundsException);
    generator.generateLogUsingState(state);
    EXPECT_EQ(state.at("DisplayState"), Value(makeData(expected)));
}

TEST_F(RawMessages, AreHandedOverWithoutADisplayToo)
{
    platform.files.clear();
    receive(packet(1, 0x1234));
    generator.generateLogUsingState(state);
    const Value entry = state.at("History").array()->elements.at(0);
    EXPECT_EQ(entry, Value(makeDictionary({{"DisplayState", makeData(expected)}})));
}

} // namespace
} // namespace pelorus::test
