#include "platform/linux/LinuxPlatform.h"

#include <QDir>
#include <QFile>
#include <QTemporaryDir>
#include <gmock/gmock.h>

namespace pelorus {

namespace {

class ResourceDirectoryTest : public testing::Test {
protected:
    void make(const std::string& name)
    {
        const QString path = QString::fromStdString(below(name));
        ASSERT_TRUE(QDir().mkpath(QFileInfo(path).path()));
        ASSERT_TRUE(QFile(path).open(QIODevice::WriteOnly));
    }
    std::string below(const std::string& name) const { return base.path().toStdString() + "/" + name; }

    QTemporaryDir base;
};

using testing::ElementsAre;
using testing::IsEmpty;

} // namespace

TEST_F(ResourceDirectoryTest, FindsByNameAndListsInOrder)
{
    for (const char* name : {"UTRAN.plist", "LTE.plist", "OSP_GSM.plist", "icon.svg", "sub/inner.plist"})
        make(name);
    QDir().mkdir(QString::fromStdString(below("folder.plist")));
    LinuxPlatform platform(base.path().toStdString());
    EXPECT_EQ(platform.findPropertyListResource("LTE"), below("LTE.plist"));
    EXPECT_THAT(platform.listPropertyListResources(),
                ElementsAre(below("LTE.plist"), below("OSP_GSM.plist"), below("UTRAN.plist")));
    for (const char* name : {"", "GSM", "lte", "icon", "folder", "sub/inner", "../LTE", "./LTE", "/LTE"})
        EXPECT_FALSE(platform.findPropertyListResource(name)) << name;
}

TEST_F(ResourceDirectoryTest, MissingDirectoryHasNone)
{
    LinuxPlatform platform(below("missing"));
    EXPECT_FALSE(platform.findPropertyListResource("LTE"));
    EXPECT_THAT(platform.listPropertyListResources(), IsEmpty());
}

TEST_F(ResourceDirectoryTest, BuildTreeGoesBeforeTheInstallation)
{
    make("bin/pelorus");
    const std::string program = below("bin/pelorus");
    EXPECT_EQ(ResourceDirectory::beside(program).path(), below("share/pelorus"));
    make("resources/icon.svg");
    EXPECT_EQ(ResourceDirectory::beside(program).path(), below("share/pelorus")) << "no list in it";
    make("resources/LTE.plist");
    EXPECT_EQ(ResourceDirectory::beside(program).path(), below("resources"));
}

TEST_F(ResourceDirectoryTest, BundleHasTheVersionOfTheProject)
{
    EXPECT_EQ(LinuxPlatform().bundleVersion(), "1.0.0");
}

} // namespace pelorus
