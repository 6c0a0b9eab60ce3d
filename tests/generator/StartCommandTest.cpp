#include "LogGenerator/Osprey/LTE/LTELogGenerator.h"
#include "LogGenerator/Osprey/UTRAN/UTRANLogGenerator.h"
#include "tests/generator/ProbeFixture.h"

namespace pelorus::test {
namespace {

using testing::IsEmpty;
using testing::UnorderedElementsAre;

class StartCommand : public ProbeFixture {
protected:
    static std::vector<std::int64_t> codes(const Value& command, std::string_view key)
    {
        const Value list = command.dictionary()->at(key);
        std::vector<std::int64_t> numbers;
        for (const Value& number : list.array()->elements)
            numbers.push_back(*number.integer());
        return numbers;
    }
    static void expectForm(const Value& command)
    {
        EXPECT_EQ(command.dictionary()->size(), 3U);
        EXPECT_EQ(command.dictionary()->at("SetState"), Value("Streaming"));
    }
};

TEST_F(StartCommand, OfLTE)
{
    const Value command = LTELogGenerator::generator(platform)->getStartCommand();
    expectForm(command);
    EXPECT_THAT(codes(command, "SetOspreyLogCodes"),
                UnorderedElementsAre(45249, 45250, 45433, 45439, 45440, 45446));
    EXPECT_THAT(codes(command, "SetCtExtraCodes"), UnorderedElementsAre(0, 1, 2));
}

TEST_F(StartCommand, NamesEachCodeOnce)
{
    const Value command = generator.getStartCommand();
    expectForm(command);
    EXPECT_THAT(codes(command, "SetOspreyLogCodes"), UnorderedElementsAre(0x1234, 0x0001));
    EXPECT_THAT(codes(command, "SetCtExtraCodes"), UnorderedElementsAre(1));
}

TEST_F(StartCommand, OfInternalCodesOnlyAsksTheBasebandForNone)
{
    const Value command = ProbeGenerator(platform, std::make_shared<InternalIndex>()).getStartCommand();
    expectForm(command);
    EXPECT_THAT(codes(command, "SetOspreyLogCodes"), IsEmpty());
    EXPECT_THAT(codes(command, "SetCtExtraCodes"), UnorderedElementsAre(2));
}

TEST_F(StartCommand, OfUTRANWithoutATemplateIsEmpty)
{
    const Value command = UTRANLogGenerator::generator(platform)->getStartCommand();
    expectForm(command);
    EXPECT_THAT(codes(command, "SetOspreyLogCodes"), IsEmpty());
    EXPECT_THAT(codes(command, "SetCtExtraCodes"), IsEmpty());
}

TEST_F(StartCommand, OfUTRANAsksForThePDPContextsAndTheSIM)
{
    platform.addResource("UTRAN", propertyListText("<dict/>"));
    const Value command = UTRANLogGenerator::generator(platform)->getStartCommand();
    EXPECT_THAT(codes(command, "SetCtExtraCodes"), testing::IsSupersetOf({0, 2}));
}

} // namespace
} // namespace pelorus::test
