#include "LogGenerator/Osprey/GSM/SimInfo.h"
#include "tests/model/ModelFixture.h"

namespace pelorus::test {
namespace {

/// A SIM-file message whose payload is no property list: it ends the program.
Bytes brokenSimFiles()
{
    Bytes message(14);
    message[0] = std::byte{0xFF};
    message[13] = std::byte{'?'};
    return message;
}

class RecoverySnapshot : public ModelFixture {
protected:
    RecoverySnapshot() { startWith("Osprey LTE"); }

    const Dictionary& file() const
    {
        return *platform.written.at("/crash-reports/PelorusSnapshot-1336123800.pelorus").dictionary();
    }
    const std::vector<Value>& entries() const { return file().at("Data").array()->elements; }
    const Dictionary& entry(std::size_t index) const { return *entries().at(index).dictionary(); }
};

TEST_F(RecoverySnapshot, HoldsWhatTheHistoryHolds)
{
    const Bytes message = simFiles("8949");
    platform.deliver(message);
    model->refresh();
    model->topLevelNodes();
    model->writeRecoverySnapshot("std::bad_alloc");

    EXPECT_EQ(file().at("Timestamp"), Value("2012-05-04 09:30:00 +0000"));
    EXPECT_EQ(file().at("Description"), Value("Recovered after std::bad_alloc"));
    ASSERT_EQ(entries().size(), 2U);
    EXPECT_EQ(entry(0).at("DisplayState"), Value(makeData(message)));
    EXPECT_EQ(entry(0).at("Description"), Value("Snapshot (2012-05-04 09:30:00 +0000)"));
    EXPECT_EQ(entry(1).at("Description"),
              Value("DLF binary (" + std::to_string(161 + message.size() - 1) + " bytes)"));
}

TEST_F(RecoverySnapshot, HoldsTheMessageThatThrew)
{
    const Bytes message = brokenSimFiles();
    EXPECT_THROW(platform.deliver(message), LogCode_0xFF0000::UnknownDataException);
    model->writeRecoverySnapshot("LogCode_0xFF0000::UnknownDataException");

    EXPECT_EQ(file().at("Description"), Value("Recovered after LogCode_0xFF0000::UnknownDataException"));
    ASSERT_EQ(entries().size(), 2U);
    EXPECT_EQ(entry(0).at("DisplayState"), Value(makeData(message)));
    EXPECT_EQ(entry(1).at("DLF").data()->size(), 161U + 13U);
}

TEST_F(RecoverySnapshot, HoldsTheMessageWithARecordBeyondItsEnd)
{
    platform.addResource("UTRAN", propertyListText("<dict><key>TRCH BLER</key><array/></dict>"));
    platform.answerTechnology("Osprey UTRAN2");
    model->restartMonitor();
    Bytes message(17); // one transport channel is announced, none is there
    message[0] = std::byte{0x01};
    message[3] = std::byte{0x0C};
    message[4] = std::byte{0xD0};
    message[14] = std::byte{0x40};
    EXPECT_THROW(platform.deliver(message), ArrayOutOfBoundsException);
    model->writeRecoverySnapshot("ArrayOutOfBoundsException");
    EXPECT_EQ(file().at("Description"), Value("Recovered after ArrayOutOfBoundsException"));
    EXPECT_EQ(entry(0).at("DisplayState"), Value(makeData(message)));
}

TEST_F(RecoverySnapshot, HoldsTheMessagesBeforeItToo)
{
    Bytes messages = simFiles("8949");
    platform.deliver(messages);
    const Bytes last = brokenSimFiles();
    EXPECT_ANY_THROW(platform.deliver(last));
    model->writeRecoverySnapshot("X");

    messages.insert(messages.end(), last.begin(), last.end());
    EXPECT_EQ(entry(0).at("DisplayState"), Value(makeData(messages)));
    EXPECT_EQ(entry(0).at("Display").dictionary()->at("SIM Info").dictionary()->at("EF-ICCID"),
              Value("8949"));
}

TEST_F(RecoverySnapshot, HoldsMessagesThatARefreshAnnouncedAndNobodyHasShown)
{
    const Bytes message = simFiles("8949");
    platform.deliver(message);
    model->refresh();
    model->writeRecoverySnapshot("X");
    EXPECT_EQ(entry(0).at("DisplayState"), Value(makeData(message)));
}

TEST_F(RecoverySnapshot, HasNoEntryForNothingNew)
{
    platform.deliver(simFiles("8949"));
    model->refresh();
    model->topLevelNodes();
    model->refresh();
    model->writeRecoverySnapshot("X");
    EXPECT_EQ(entries().size(), 2U);
}

TEST_F(RecoverySnapshot, IsWrittenWhenTheGeneratorThrowsOnceMore)
{
    platform.deliver(simFiles("8949"));
    model->refresh();
    model->topLevelNodes();
    platform.addResource("UTRAN", propertyListText("<dict><key>RRC Info</key><integer>1</integer></dict>"));
    platform.answerTechnology("Osprey UTRAN2");
    model->restartMonitor();
    EXPECT_ANY_THROW(platform.deliver(simFiles("8950")));
    log.take();
    model->writeRecoverySnapshot("std::invalid_argument");
    EXPECT_EQ(errors().back(),
              "The last messages are not in the recovered snapshot: a display template holds "
              "something that is no dictionary, array or string");
    ASSERT_EQ(entries().size(), 2U);
    EXPECT_EQ(entry(0).at("DisplayState"), Value(makeData(simFiles("8949"))));
}

TEST_F(RecoverySnapshot, IsWrittenWhenNoGeneratorIsLeft)
{
    platform.deliver(simFiles("8949"));
    model->refresh();
    model->topLevelNodes();
    platform.answerTechnology("Osprey 5G");
    model->restartMonitor();
    model->writeRecoverySnapshot("X");
    ASSERT_EQ(entries().size(), 1U);
    EXPECT_EQ(entry(0).at("DisplayState"), Value(makeData(simFiles("8949"))));
    EXPECT_EQ(file().at("Description"), Value("Recovered after X"));
}

TEST_F(RecoverySnapshot, SaysWhenItCannotBeWritten)
{
    platform.writesFail = true;
    model->writeRecoverySnapshot("X");
    EXPECT_EQ(errors().back(),
              "Unable to write snapshot to /crash-reports/PelorusSnapshot-1336123800.pelorus");
}

} // namespace
} // namespace pelorus::test
