#include "LogGenerator/C2K/C2KLogGenerator.h"
#include "LogGenerator/GSM/GSMLogGenerator.h"
#include "LogGenerator/Osprey/GSM/OSP_GSMLogGenerator.h"
#include "LogGenerator/Osprey/LTE/LTELogGenerator.h"
#include "LogGenerator/Osprey/UTRAN/UTRANLogGenerator.h"
#include "tests/generator/GeneratorFixture.h"

#include <typeinfo>

namespace pelorus::test {
namespace {

using testing::ElementsAre;

class Factory : public GeneratorFixture {
protected:
    std::unique_ptr<LogGenerator> make(std::string_view technology)
    {
        return LogGenerator::generatorFromTechnology(platform, technology);
    }
    template <class Generator> bool makes(std::string_view technology)
    {
        const auto generator = make(technology);
        return generator && typeid(*generator) == typeid(Generator);
    }
};

TEST_F(Factory, MakesTheGeneratorOfEachTechnology)
{
    EXPECT_TRUE(makes<GSMLogGenerator>("IFX"));
    EXPECT_TRUE(makes<OSP_GSMLogGenerator>("Osprey GSM"));
    EXPECT_TRUE(makes<C2KLogGenerator>("Osprey CDMA"));
    EXPECT_TRUE(makes<LTELogGenerator>("Osprey LTE"));
    EXPECT_TRUE(makes<UTRANLogGenerator>("Osprey UTRAN2"));
}

TEST_F(Factory, MakesNoneOfAnyOtherName)
{
    for (const std::string_view name :
         {"", "ifx", "Osprey", "Osprey lte", "Osprey LTE ", " IFX", "Osprey UTRAN", "Osprey UTRAN22"})
        EXPECT_EQ(make(name), nullptr) << name;
    EXPECT_EQ(make(std::string_view("IFX\0", 4)), nullptr);
}

TEST_F(Factory, ComparesByValue)
{
    std::string name = "Osprey ";
    name += "LTE";
    EXPECT_TRUE(makes<LTELogGenerator>(name));
}

TEST_F(Factory, MakesADistinctInstanceEachTime)
{
    const auto one = make("Osprey LTE");
    const auto two = make("Osprey LTE");
    EXPECT_NE(one, two);
    EXPECT_NE(LTELogGenerator::generator(platform), LTELogGenerator::generator(platform));
}

TEST_F(Factory, KnowsTheTechnologiesInOrder)
{
    const auto names = LogGenerator::technologies();
    EXPECT_THAT(std::vector<std::string_view>(names.begin(), names.end()),
                ElementsAre("IFX", "Osprey GSM", "Osprey CDMA", "Osprey LTE", "Osprey UTRAN2"));
}

TEST_F(Factory, NewGeneratorFindsTheHistoryOfTheOneBefore)
{
    make("Osprey LTE")->generateLogUsingState(state);
    EXPECT_EQ(make("IFX")->getSaveContentsFromState(state)->elements.size(), 1U);
}

TEST_F(Factory, EveryGeneratorRecordsOneEntryAtEachGeneration)
{
    for (const std::string_view technology : LogGenerator::technologies()) {
        State ownState;
        const auto generator = make(technology);
        generator->generateLogUsingState(ownState);
        EXPECT_EQ(ownState.at("History").array()->elements.size(), 1U) << technology;
        generator->generateLogUsingState(ownState);
        EXPECT_EQ(ownState.at("History").array()->elements.size(), 2U) << technology;
    }
}

TEST_F(Factory, SaveContentsAreAnArrayOfTheirOwn)
{
    for (const std::string_view technology : LogGenerator::technologies()) {
        State ownState;
        const auto generator = make(technology);
        generator->generateLogUsingState(ownState);
        generator->getSaveContentsFromState(ownState)->elements.clear();
        EXPECT_EQ(ownState.at("History").array()->elements.size(), 1U) << technology;
    }
}

TEST_F(Factory, OnlyOspreyGeneratorsSaveADlfFile)
{
    for (const std::string_view technology : LogGenerator::technologies()) {
        const auto contents = make(technology)->getSaveContentsFromState(State());
        EXPECT_EQ(contents->elements.size(), technology == "IFX" ? 0U : 1U) << technology;
    }
}

/// The contract itself, without a technology.
class BareGenerator : public LogGenerator {
public:
    explicit BareGenerator(Platform& system) : LogGenerator(system) { init(); }
};

TEST_F(Factory, GeneratorSaysThatItIsCreated)
{
    const BareGenerator generator(platform);
    EXPECT_THAT(log.take(), ElementsAre("<4>Creating Log object: " +
                                        fmt::sprintf("%p", static_cast<const void*>(&generator))));
}

TEST_F(Factory, OperationThatIsNotImplementedIsAProgrammingError)
{
    BareGenerator generator(platform);
    EXPECT_THROW(generator.updateState(state, {}), std::logic_error);
    EXPECT_THROW(generator.generateLogUsingState(state), std::logic_error);
    EXPECT_THROW(static_cast<void>(generator.getStartCommand()), std::logic_error);
    EXPECT_THROW(static_cast<void>(generator.getSaveContentsFromState(state)), std::logic_error);
}

} // namespace
} // namespace pelorus::test
