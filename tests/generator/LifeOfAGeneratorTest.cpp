#include "LogGenerator/Osprey/GSM/OSP_GSMLogGenerator.h"
#include "LogGenerator/Osprey/LTE/LTELogGenerator.h"
#include "LogGenerator/Osprey/UTRAN/UTRANLogGenerator.h"
#include "platform/Console.h"
#include "tests/generator/ProbeFixture.h"

namespace pelorus::test {
namespace {

using testing::ElementsAre;
using testing::IsEmpty;

/// What the generators say as they come and go.
class LifeOfAGenerator : public GeneratorFixture {
protected:
    LifeOfAGenerator()
    {
        setConsole([this](std::string_view line) { console.emplace_back(line); });
    }
    ~LifeOfAGenerator() override { setConsole(nullptr); }

    /// The lines of a creation, without those of the sections.
    std::vector<std::string> creationLines()
    {
        auto lines = logged();
        std::erase_if(lines, [](const std::string& line) { return line.starts_with("<4>Array Count: "); });
        return lines;
    }
    std::vector<std::string> console;
};

TEST_F(LifeOfAGenerator, LTE)
{
    auto generator = LTELogGenerator::generator(platform);
    EXPECT_THAT(creationLines(), ElementsAre("<3>Creating LTELogGenerator object",
                                             "<3>Creating OSPLogGenerator2 object with %p",
                                             "<4>Creating Log object: %p", "<3>Class Index: 1"));
    generator.reset();
    EXPECT_THAT(logged(), ElementsAre("<4>LTELogGenerator is destructed %p",
                                      "<4>OSP_GSMLogGenerator is destructed %p"));
}

TEST_F(LifeOfAGenerator, GSM)
{
    auto generator = OSP_GSMLogGenerator::generator(platform);
    EXPECT_THAT(creationLines(), ElementsAre("<3>Creating OSP_GSMLogGenerator object",
                                             "<3>Creating OSPLogGenerator2 object with %p",
                                             "<4>Creating Log object: %p", "<3>Class Index: 1"));
    generator.reset();
    EXPECT_THAT(logged(), ElementsAre("<4>OSP_GSMLogGenerator is destructed %p",
                                      "<4>OSP_GSMLogGenerator is destructed %p"));
}

TEST_F(LifeOfAGenerator, UTRAN)
{
    platform.addResource("UTRAN", propertyListText("<dict/>"));
    auto generator = UTRANLogGenerator::generator(platform);
    EXPECT_THAT(creationLines(),
                ElementsAre("<3>Creating OSPLogGenerator2 object with %p", "<4>Creating Log object: %p",
                            "<3>Class Index: 1", "<3>Created UTRANLogGenerator object"));
    generator.reset();
    EXPECT_THAT(logged(), ElementsAre("<4>OSP_GSMLogGenerator is destructed %p"));
}

TEST_F(LifeOfAGenerator, UTRANWithoutATemplateSaysNothing)
{
    platform.addResource("LTE", propertyListText("<dict/>"));
    auto generator = UTRANLogGenerator::generator(platform);
    EXPECT_THAT(log.take(), IsEmpty());
    generator.reset();
    EXPECT_THAT(logged(), ElementsAre("<4>OSP_GSMLogGenerator is destructed %p"));
    EXPECT_THAT(console, IsEmpty());
}

TEST_F(LifeOfAGenerator, SectionsAreMadeBeforeTheGenerator)
{
    const auto generator = LTELogGenerator::generator(platform);
    const auto lines = logged();
    ASSERT_EQ(lines.size(), 15U);
    EXPECT_EQ(lines[0], "<3>Creating LTELogGenerator object");
    EXPECT_EQ(lines[1], "<4>Array Count: 3"); // serving cell info: 0xB0C2, 0xB0C1, 0xFF0001
    for (std::size_t section = 2; section <= 11; ++section)
        EXPECT_EQ(lines[section], "<4>Array Count: 1");
    EXPECT_EQ(lines[12], "<3>Creating OSPLogGenerator2 object with %p");
}

TEST_F(LifeOfAGenerator, LinesNameTheIndexAndTheGenerator)
{
    const auto index = std::make_shared<ProbeIndex>();
    log.take();
    auto generator = std::make_unique<ProbeGenerator>(platform, index);
    const std::string address = fmt::sprintf("%p", static_cast<const void*>(generator.get()));
    EXPECT_THAT(log.take(), ElementsAre(fmt::sprintf("<3>Creating OSPLogGenerator2 object with %p",
                                                     static_cast<const void*>(index.get())),
                                        "<4>Creating Log object: " + address, "<3>Class Index: 2"));
    generator.reset();
    EXPECT_THAT(log.take(), ElementsAre("<4>OSP_GSMLogGenerator is destructed " + address));
}

TEST_F(LifeOfAGenerator, IndexEndsWithItsGenerator)
{
    auto generator = LTELogGenerator::generator(platform);
    EXPECT_THAT(console, IsEmpty());
    generator.reset();
    EXPECT_THAT(console, ElementsAre("Deallocing ClassIndex"));
}

} // namespace
} // namespace pelorus::test
