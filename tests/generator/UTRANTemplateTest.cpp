#include "LogGenerator/Osprey/UTRAN/UTRANLogGenerator.h"
#include "tests/generator/GeneratorFixture.h"
#include "tests/support/SectionFixture.h"

namespace pelorus::test {
namespace {

class UTRANTemplate : public GeneratorFixture {
protected:
    void addTemplate(const std::string& name, const std::string& heading)
    {
        platform.addResource(name,
                             propertyListText("<dict><key>" + heading + "</key><string>-</string></dict>"));
    }
    std::string shown()
    {
        UTRANLogGenerator generator(platform);
        generator.generateLogUsingState(state);
        return state.find("Display") ? textOf(state.at("Display")) : "(none)";
    }
};

TEST_F(UTRANTemplate, IsTheResourceThatSaysUTRAN)
{
    addTemplate("LTE", "wrong");
    addTemplate("OSP_UTRAN2", "right");
    EXPECT_EQ(shown(), "right: -\n");
}

TEST_F(UTRANTemplate, IsFoundInAnyCase)
{
    addTemplate("my.utRaN.rows", "right");
    EXPECT_EQ(shown(), "right: -\n");
}

TEST_F(UTRANTemplate, IsTheFirstOfSeveral)
{
    addTemplate("UTRAN", "first");
    addTemplate("aUTRAN", "second");
    EXPECT_EQ(shown(), "first: -\n");
}

TEST_F(UTRANTemplate, IsMissingWithoutAResourceThatSaysSo)
{
    addTemplate("UTRA", "wrong");
    addTemplate("UTR-AN", "wrong");
    platform.addFile("/elsewhere/UTRAN.plist", "");
    EXPECT_EQ(shown(), "(none)");
    EXPECT_EQ(errors().back(), "<3>Cannot load template for display");
}

TEST_F(UTRANTemplate, IsMissingWithoutAnyResource)
{
    EXPECT_EQ(shown(), "(none)");
}

} // namespace
} // namespace pelorus::test
