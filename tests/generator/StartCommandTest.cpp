#include "LogGenerator/C2K/C2KLogGenerator.h"
#include "LogGenerator/Osprey/GSM/OSP_GSMLogGenerator.h"
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

TEST_F(StartCommand, OfUTRAN)
{
    platform.addResource("UTRAN", propertyListText("<dict/>"));
    const Value command = UTRANLogGenerator::generator(platform)->getStartCommand();
    expectForm(command);
    EXPECT_THAT(codes(command, "SetOspreyLogCodes"),
                UnorderedElementsAre(0xD0E0, 0xD0E2, 0xD00A, 0xD00C, 0xD00E));
    EXPECT_THAT(codes(command, "SetCtExtraCodes"), UnorderedElementsAre(0, 1, 2));
}

TEST_F(StartCommand, OfGSM)
{
    const Value command = OSP_GSMLogGenerator::generator(platform)->getStartCommand();
    expectForm(command);
    EXPECT_THAT(codes(command, "SetOspreyLogCodes"),
                UnorderedElementsAre(0x4005, 0x4031, 0x4116, 0x4125, 0x4127, 0x4157, 0x417A, 0x4221, 0x5072,
                                     0x5076, 0x512C, 0x5134, 0x5137, 0x51F4, 0x51F5, 0x51F6, 0x51F8, 0x51FB,
                                     0x51FD, 0x51FF, 0x7130, 0x7131, 0x7132, 0x7135, 0x7150));
    EXPECT_THAT(codes(command, "SetCtExtraCodes"), UnorderedElementsAre(0, 1, 2));
}

TEST_F(StartCommand, OfCDMAHasItsCodesInOrderAndNoInternalOnes)
{
    const Value command = C2KLogGenerator::generator(platform)->getStartCommand();
    EXPECT_EQ(command.dictionary()->size(), 2U);
    EXPECT_EQ(command.dictionary()->at("SetState"), Value("Streaming"));
    EXPECT_THAT(codes(command, "SetOspreyLogCodes"),
                testing::ElementsAre(0x108A, 0x1183, 0x1192, 0x12B6, 0x119C, 0x119D, 0x127E, 0x134F));
}

} // namespace
} // namespace pelorus::test
