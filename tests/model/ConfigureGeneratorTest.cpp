#include "tests/model/ModelFixture.h"

namespace pelorus::test {
namespace {

using testing::ElementsAre;
using testing::IsEmpty;

class ConfigureGenerator : public ModelFixture {
protected:
    /// The lines after those of the ports.
    std::vector<std::string> startErrors()
    {
        model->startMonitor();
        auto lines = errors();
        EXPECT_EQ(lines.at(0), " ***** Created ports (send=%p, recv=%p)");
        lines.erase(lines.begin());
        return lines;
    }
};

TEST_F(ConfigureGenerator, AsksForTheTechnologyWithinOneSecondEach)
{
    model->startMonitor();
    const SentMessage& command = platform.sent.at(0);
    EXPECT_EQ(command.port, "io.pelorus.ScriptedRemotePort");
    EXPECT_EQ(command.id, 0);
    EXPECT_EQ(command.sendTimeout, Seconds(1.0));
    EXPECT_EQ(command.receiveTimeout, Seconds(1.0));
    EXPECT_EQ(command.propertyList(), Value(makeDictionary({{"GetTechnology", "GetTechnology"}})));
    const std::string text(reinterpret_cast<const char*>(command.payload.data()), command.payload.size());
    EXPECT_EQ(text.substr(0, 5), "<?xml");
}

TEST_F(ConfigureGenerator, CommandCannotBeSent)
{
    platform.requestAnswer = {-1, std::nullopt};
    EXPECT_THAT(startErrors(), ElementsAre(" ***** Could not send the GetTechnology command (got error=-1)",
                                           "No log generator technology works"));
}

TEST_F(ConfigureGenerator, StatusCountsEvenWithAReply)
{
    platform.requestAnswer.status = -2;
    EXPECT_THAT(startErrors(), ElementsAre(" ***** Could not send the GetTechnology command (got error=-2)",
                                           "No log generator technology works"));
}

TEST_F(ConfigureGenerator, NoReplyData)
{
    platform.requestAnswer = {0, std::nullopt};
    EXPECT_THAT(startErrors(), ElementsAre(" ***** No response to GetTechnology; cannot configure",
                                           "No log generator technology works"));
}

TEST_F(ConfigureGenerator, ReplyIsNoPropertyList)
{
    for (const std::string_view reply : {"", "IFX", "<plist", "bplist00"}) {
        platform.answerWith(reply);
        EXPECT_THAT(startErrors(),
                    ElementsAre(" ***** Could not parse reply to GetTechnology; cannot configure",
                                "No log generator technology works"));
    }
}

TEST_F(ConfigureGenerator, ReplyIsNoDictionary)
{
    platform.answerWith(propertyListText("<array><string>GetTechnology</string></array>"));
    EXPECT_THAT(startErrors(), ElementsAre(" ***** Could not parse reply to GetTechnology; cannot configure",
                                           "No log generator technology works"));
}

TEST_F(ConfigureGenerator, ReplyHasNoAnswer)
{
    platform.answerWith(propertyListText("<dict><key>Technology</key><string>IFX</string></dict>"));
    EXPECT_THAT(startErrors(), ElementsAre(" ***** Reply to GetTechnology had no answer; cannot configure",
                                           "No log generator technology works"));
}

TEST_F(ConfigureGenerator, UnknownTechnologyGivesNoGenerator)
{
    for (const std::string_view name : {"Osprey 5G", "osprey lte", "Osprey LTE ", "Osprey", ""}) {
        platform.answerTechnology(name);
        EXPECT_THAT(startErrors(),
                    ElementsAre("Got log generated: (nil)", "No log generator technology works"));
    }
}

TEST_F(ConfigureGenerator, AnswerThatIsNoTextIsAnUnknownTechnology)
{
    platform.answerWith(propertyListText("<dict><key>GetTechnology</key><integer>1</integer></dict>"));
    EXPECT_THAT(startErrors(), ElementsAre("Got log generated: (nil)", "No log generator technology works"));
}

TEST_F(ConfigureGenerator, SaysWhichGeneratorItGot)
{
    EXPECT_THAT(startErrors(),
                ElementsAre("Creating LTELogGenerator object", "Creating OSPLogGenerator2 object with %p",
                            "Class Index: 1", "Got log generated: %p", "Starting the display update timer"));
}

TEST_F(ConfigureGenerator, BinaryReplyIsReadToo)
{
    platform.requestAnswer = {0, serializePropertyList(makeDictionary({{"GetTechnology", "Osprey LTE"}}),
                                                       PropertyListForm::binary)};
    model->startMonitor();
    EXPECT_TRUE(started());
}

TEST_F(ConfigureGenerator, UnknownTechnologyIsTriedAgainWithoutLimit)
{
    platform.answerTechnology("Osprey 5G");
    model->startMonitor();
    EXPECT_EQ(platform.sent.size(), 1U);
    for (std::size_t attempt = 1; attempt <= 50; ++attempt) {
        platform.advance(4999ms);
        EXPECT_EQ(platform.sent.size(), attempt);
        platform.advance(1ms);
        EXPECT_EQ(platform.sent.size(), attempt + 1);
    }
    log.take();
    platform.advance(5s);
    EXPECT_THAT(errors(), ElementsAre(" ***** Created ports (send=%p, recv=%p)", "Got log generated: (nil)",
                                      "No log generator technology works"));
}

TEST_F(ConfigureGenerator, UnknownTechnologyDropsThePreviousGenerator)
{
    startWith("Osprey LTE");
    platform.answerTechnology("Osprey 5G");
    model->restartMonitor();
    EXPECT_FALSE(started());
    EXPECT_EQ(model->topLevelNodes(), nullptr);
    EXPECT_EQ(model->getSaveContents(), nullptr);
}

/// A running model whose channel is made anew while "GetTechnology" fails.
class PreviousGenerator : public ConfigureGenerator {
protected:
    PreviousGenerator()
    {
        startWith("Osprey LTE");
        platform.sent.clear();
    }
    void expectItGoesOn(std::string_view complaint)
    {
        model->restartMonitor();
        EXPECT_THAT(errors(), ElementsAre(" ***** Created ports (send=%p, recv=%p)", std::string(complaint),
                                          "Starting the display update timer"));
        ASSERT_EQ(platform.sent.size(), 2U);
        EXPECT_EQ(
            platform.sent[1].propertyList().dictionary()->at("SetOspreyLogCodes").array()->elements.size(),
            6U);
        EXPECT_TRUE(model->isConnected());
        platform.deliver(simFiles("8949"));
        model->topLevelNodes();
        EXPECT_EQ(shownAt("/SIM Info/EF-ICCID"), "8949");
    }
};

TEST_F(PreviousGenerator, IsUsedWhenTheCommandCannotBeSent)
{
    platform.requestAnswer = {-1, std::nullopt};
    expectItGoesOn(" ***** Could not send the GetTechnology command (got error=-1)");
}

TEST_F(PreviousGenerator, IsUsedWhenThereIsNoReply)
{
    platform.requestAnswer = {0, std::nullopt};
    expectItGoesOn(" ***** No response to GetTechnology; cannot configure");
}

TEST_F(PreviousGenerator, IsUsedWhenTheReplyCannotBeParsed)
{
    platform.answerWith("no property list");
    expectItGoesOn(" ***** Could not parse reply to GetTechnology; cannot configure");
}

TEST_F(PreviousGenerator, IsUsedWhenTheReplyHasNoAnswer)
{
    platform.answerWith(propertyListText("<dict/>"));
    expectItGoesOn(" ***** Reply to GetTechnology had no answer; cannot configure");
}

} // namespace
} // namespace pelorus::test
