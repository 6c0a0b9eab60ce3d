#include "platform/linux/LinuxPlatform.h"
#include "platform/linux/SnapshotDirectory.h"

#include "platform/linux/Files.h"
#include "tests/linux/PortFixture.h"

#include <QDir>
#include <QFile>
#include <array>
#include <cerrno>
#include <csignal>
#include <ctime>
#include <fcntl.h>
#include <sys/resource.h>
#include <sys/stat.h>

namespace pelorus {

using test::EnvironmentVariable;

namespace {

/// No file gets longer, as on a full disk.
class FileSizeLimit {
public:
    explicit FileSizeLimit(rlim_t bytes)
    {
        ::getrlimit(RLIMIT_FSIZE, &before);
        handler = std::signal(SIGXFSZ, SIG_IGN);
        const rlimit limit = {bytes, before.rlim_max};
        ::setrlimit(RLIMIT_FSIZE, &limit);
    }
    ~FileSizeLimit()
    {
        ::setrlimit(RLIMIT_FSIZE, &before);
        std::signal(SIGXFSZ, handler);
    }
    FileSizeLimit(const FileSizeLimit&) = delete;
    FileSizeLimit& operator=(const FileSizeLimit&) = delete;

private:
    rlimit before = {};
    void (*handler)(int) = nullptr;
};

class FilesTest : public testing::Test {
protected:
    std::string below(const std::string& name) const { return base.path().toStdString() + "/" + name; }
    std::string contentOf(const std::string& name) const
    {
        QFile file(QString::fromStdString(below(name)));
        EXPECT_TRUE(file.open(QIODevice::ReadOnly));
        return file.readAll().toStdString();
    }
    bool isDirectory(const std::string& path) const
    {
        struct stat status = {};
        return ::stat(path.c_str(), &status) == 0 && S_ISDIR(status.st_mode);
    }

    QTemporaryDir base;
    LinuxPlatform platform;
};

} // namespace

TEST_F(FilesTest, PropertyListIsWrittenInPlace)
{
    {
        QFile old(QString::fromStdString(below("list")));
        ASSERT_TRUE(old.open(QIODevice::WriteOnly));
        old.write(QByteArray(100000, 'o'));
    }
    ASSERT_EQ(::link(below("list").c_str(), below("same").c_str()), 0);
    EXPECT_TRUE(platform.writePropertyList(makeDictionary({{"Key", "text"}}), below("list")));
    const std::string written = contentOf("list");
    EXPECT_TRUE(written.starts_with("<?xml version=\"1.0\" encoding=\"UTF-8\"?>")) << written;
    EXPECT_NE(written.find("<key>Key</key>"), std::string::npos) << written;
    EXPECT_NE(written.find("<string>text</string>"), std::string::npos) << written;
    EXPECT_EQ(contentOf("same"), written) << "the same file, not another in its place";
}

TEST_F(FilesTest, FailureToWriteIsSaid)
{
    const Value value = makeDictionary({{"Key", "text"}});
    EXPECT_FALSE(platform.writePropertyList(value, below("missing/list")));
    EXPECT_FALSE(platform.writePropertyList(value, base.path().toStdString()));
    EXPECT_FALSE(platform.writePropertyList(value, "/dev/full"));
    EXPECT_FALSE(platform.writePropertyList(Value(), below("nil")));
    EXPECT_FALSE(platform.fileExists(below("nil")));
}

TEST_F(FilesTest, HalfAFileIsNotLeft)
{
    const FileSizeLimit limit(1000);
    const Bytes tooLong(5000);
    errno = 0;
    EXPECT_FALSE(writeWholeFile(below("new"), tooLong));
    EXPECT_EQ(errno, EFBIG);
    EXPECT_FALSE(platform.fileExists(below("new")));
}

TEST_F(FilesTest, ReplacementIsWholeOrNotAtAll)
{
    const auto replace = [this](const std::string& name, std::string_view text) {
        return replaceWholeFile(below(name), std::as_bytes(std::span(text)));
    };
    EXPECT_TRUE(replace("file", "first")) << "there need not be an old one";
    ASSERT_EQ(::chmod(below("file").c_str(), 0640), 0);
    ASSERT_EQ(::symlink("file", below("link").c_str()), 0);
    EXPECT_TRUE(replace("link", "second"));
    EXPECT_EQ(contentOf("file"), "second");
    struct stat status = {};
    ASSERT_EQ(::lstat(below("link").c_str(), &status), 0);
    EXPECT_TRUE(S_ISLNK(status.st_mode));
    ASSERT_EQ(::stat(below("file").c_str(), &status), 0);
    EXPECT_EQ(status.st_mode & 07777, 0640u);
    {
        const FileSizeLimit limit(1000);
        errno = 0;
        EXPECT_FALSE(replace("file", std::string(5000, 'x')));
        EXPECT_EQ(errno, EFBIG);
    }
    EXPECT_EQ(contentOf("file"), "second");
    EXPECT_EQ(QDir(base.path()).entryList(QDir::Files | QDir::Hidden), QStringList({"file", "link"}));
}

TEST_F(FilesTest, WhatIsNoRegularFileIsNotReplaced)
{
    ASSERT_EQ(::mkfifo(below("pipe").c_str(), 0600), 0);
    const FileDescriptor reader(::open(below("pipe").c_str(), O_RDONLY | O_NONBLOCK));
    EXPECT_TRUE(replaceWholeFile(below("pipe"), std::as_bytes(std::span("text", 4))));
    std::array<char, 5> read{};
    EXPECT_EQ(::read(reader.get(), read.data(), read.size()), 4);
    EXPECT_STREQ(read.data(), "text");
    errno = 0;
    EXPECT_FALSE(replaceWholeFile("/dev/full", std::as_bytes(std::span("text", 4))));
    EXPECT_EQ(errno, ENOSPC);
    EXPECT_TRUE(platform.fileExists("/dev/full"));
}

TEST_F(FilesTest, ReadsWholeFiles)
{
    for (const int size : {0, 1, 4095, 4096, 4097, 300000}) {
        QFile file(QString::fromStdString(below("file")));
        ASSERT_TRUE(file.open(QIODevice::WriteOnly));
        file.write(QByteArray(size, 'f'));
        file.close();
        const auto bytes = platform.readFile(below("file"));
        ASSERT_TRUE(bytes);
        EXPECT_EQ(bytes->size(), static_cast<std::size_t>(size));
        EXPECT_EQ(*bytes, Bytes(static_cast<std::size_t>(size), std::byte{'f'}));
    }
    EXPECT_TRUE(platform.fileExists(below("file")));
    EXPECT_TRUE(platform.fileExists(base.path().toStdString()));
    EXPECT_FALSE(platform.fileExists(below("missing")));
    EXPECT_FALSE(platform.readFile(below("missing")));
    EXPECT_FALSE(platform.readFile(base.path().toStdString()));
    const auto proc = platform.readFile("/proc/self/status"); // says that its size is 0
    ASSERT_TRUE(proc);
    EXPECT_GT(proc->size(), 100u);
}

TEST_F(FilesTest, SnapshotsGoToTheHandsetsDirectoryWhereThereIsOne)
{
    const EnvironmentVariable state("XDG_STATE_HOME", below("state").c_str());
    EXPECT_EQ(findSnapshotDirectory(base.path().toStdString()), base.path().toStdString());
    EXPECT_FALSE(isDirectory(below("state"))) << "no other is made then";
}

TEST_F(FilesTest, SnapshotsElseGoToTheStateDirectoryMadeWhenMissing)
{
    const EnvironmentVariable home("HOME", below("home").c_str());
    {
        const EnvironmentVariable state("XDG_STATE_HOME", below("state").c_str());
        EXPECT_EQ(findSnapshotDirectory(below("none")), below("state/pelorus/CrashReporter"));
        EXPECT_TRUE(isDirectory(below("state/pelorus/CrashReporter")));
        EXPECT_EQ(findSnapshotDirectory(below("none")), below("state/pelorus/CrashReporter"));
    }
    for (const char* ignored : {static_cast<const char*>(nullptr), "", "relative"}) {
        const EnvironmentVariable state("XDG_STATE_HOME", ignored);
        EXPECT_EQ(findSnapshotDirectory(below("none")), below("home/.local/state/pelorus/CrashReporter"));
    }
    EXPECT_TRUE(isDirectory(below("home/.local/state/pelorus/CrashReporter")));
}

TEST_F(FilesTest, SnapshotDirectoryThatCannotBeMadeIsNamedAllTheSame)
{
    const EnvironmentVariable state("XDG_STATE_HOME", "/proc/nowhere");
    EXPECT_EQ(findSnapshotDirectory(below("none")), "/proc/nowhere/pelorus/CrashReporter");
    EXPECT_FALSE(platform.writePropertyList(makeDictionary(), platform.snapshotDirectory() + "/snapshot"));
}

TEST_F(FilesTest, LocalZoneCountsTheDaylightSavingHour)
{
    struct Zone {
        const char* name;
        int offset;
        bool daylightSaving;
    };
    // Zones that always, or never, save daylight.
    for (const auto& [name, offset, daylightSaving] :
         {Zone{"UTC0", 0, false}, Zone{"EST5", -18000, false}, Zone{"XXX-5:45", 20700, false},
          Zone{"XXX3YYY2,0/0,J365/25", -7200, true}}) {
        const EnvironmentVariable zone("TZ", name);
        ::tzset();
        EXPECT_EQ(platform.localZone().offset.count(), offset) << name;
        EXPECT_EQ(platform.localZone().daylightSaving, daylightSaving) << name;
    }
    ::tzset();
}

} // namespace pelorus
