#include "platform/linux/PortDirectory.h"

#include "tests/linux/PortFixture.h"

#include <fcntl.h>
#include <sys/stat.h>

namespace pelorus {

using test::EnvironmentVariable;

namespace {

unsigned modeOf(const std::string& path)
{
    struct stat status = {};
    EXPECT_EQ(::lstat(path.c_str(), &status), 0) << path;
    return status.st_mode & 07777;
}

class PortDirectoryTest : public testing::Test {
protected:
    std::string below(const std::string& name) const { return base.path().toStdString() + "/" + name; }
    std::string refusal(const std::string& path) const
    {
        std::string why;
        EXPECT_FALSE(PortDirectory::open(path, why));
        return why;
    }

    QTemporaryDir base;
};

} // namespace

TEST_F(PortDirectoryTest, ComesFromTheEnvironment)
{
    const EnvironmentVariable runtime("XDG_RUNTIME_DIR", "/run/user/77");
    {
        const EnvironmentVariable chosen("PELORUS_PORT_DIRECTORY", "/some/ports");
        EXPECT_EQ(PortDirectory::locate(), "/some/ports");
    }
    const EnvironmentVariable chosen("PELORUS_PORT_DIRECTORY", nullptr);
    EXPECT_EQ(PortDirectory::locate(), "/run/user/77/pelorus");
    const EnvironmentVariable noRuntime("XDG_RUNTIME_DIR", nullptr);
    EXPECT_EQ(PortDirectory::locate(), "/tmp/pelorus-" + std::to_string(::getuid()));
}

TEST_F(PortDirectoryTest, IsMadeForTheUserAlone)
{
    const mode_t mask = ::umask(0);
    std::string why;
    const auto directory = PortDirectory::open(below("ports/"), why);
    ::umask(mask);
    ASSERT_TRUE(directory) << why;
    EXPECT_EQ(directory->path(), below("ports"));
    EXPECT_EQ(modeOf(below("ports")), 0700u);
    EXPECT_TRUE(PortDirectory::open(below("ports"), why)) << "one that exists is taken";
}

TEST_F(PortDirectoryTest, IsRefusedWhenOthersCanWriteToIt)
{
    ::mkdir(below("ports").c_str(), 0700);
    ::chmod(below("ports").c_str(), 0720);
    EXPECT_EQ(refusal(below("ports")),
              "port directory " + below("ports") + ": other users can write to it (mode 0720)");
    ::chmod(below("ports").c_str(), 01702);
    EXPECT_EQ(refusal(below("ports")),
              "port directory " + below("ports") + ": other users can write to it (mode 1702)");
    ::chmod(below("ports").c_str(), 0755);
    std::string why;
    EXPECT_TRUE(PortDirectory::open(below("ports"), why)) << why;
}

TEST_F(PortDirectoryTest, IsRefusedWhenAnotherUserOwnsIt)
{
    if (::geteuid() != 0)
        GTEST_SKIP() << "only root can give a directory away";
    ::mkdir(below("ports").c_str(), 0700);
    ASSERT_EQ(::chown(below("ports").c_str(), 4321, 0), 0);
    EXPECT_EQ(refusal(below("ports")),
              "port directory " + below("ports") + ": belongs to user 4321, not to user 0");
}

TEST_F(PortDirectoryTest, IsRefusedWhenItIsNoDirectory)
{
    ::mkdir(below("real").c_str(), 0700);
    ASSERT_EQ(::symlink(below("real").c_str(), below("link").c_str()), 0);
    EXPECT_EQ(refusal(below("link")), "port directory " + below("link") + ": is a symbolic link");
    EXPECT_EQ(refusal(below("link/")), "port directory " + below("link") + ": is a symbolic link");
    const FileDescriptor file(::open(below("file").c_str(), O_CREAT | O_WRONLY, 0600));
    EXPECT_EQ(refusal(below("file")), "port directory " + below("file") + ": is not a directory");
    EXPECT_EQ(refusal(below("no/ports")),
              "port directory " + below("no/ports") + ": cannot be made: No such file or directory");
}

TEST_F(PortDirectoryTest, NamesThatLeaveItOrDoNotFitAreRefused)
{
    std::string why;
    const auto directory = PortDirectory::open(base.path().toStdString(), why);
    ASSERT_TRUE(directory);
    EXPECT_EQ(directory->socketPath("io.pelorus.TelephonyServer", why), below("io.pelorus.TelephonyServer"));
    for (const std::string name : {"", ".", "..", "a/b", "../a"}) {
        EXPECT_FALSE(directory->socketPath(name, why));
        EXPECT_EQ(why, "\"" + name + "\" cannot be the name of a port");
    }
    const std::size_t fits = 107 - below("").size();
    EXPECT_TRUE(directory->socketPath(std::string(fits, 'n'), why));
    EXPECT_FALSE(directory->socketPath(std::string(fits + 1, 'n'), why));
    EXPECT_EQ(why,
              below(std::string(fits + 1, 'n')) + ": the path of a port has 107 bytes at most, this has 108");
}

} // namespace pelorus
