#include "platform/linux/FileLogSink.h"

#include <QFile>
#include <QTemporaryDir>
#include <cerrno>
#include <gtest/gtest.h>

namespace pelorus {

namespace {

class FileLogSinkTest : public testing::Test {
protected:
    std::string content() const
    {
        QFile file(QString::fromStdString(path));
        EXPECT_TRUE(file.open(QIODevice::ReadOnly));
        return file.readAll().toStdString();
    }

    QTemporaryDir directory;
    std::string path = directory.path().toStdString() + "/log";
    std::string why;
};

} // namespace

TEST_F(FileLogSinkTest, WritesPriorityTextAndExactlyOneLineFeed)
{
    const auto sink = FileLogSink::open(path, why);
    ASSERT_TRUE(sink) << why;
    sink->write(3, "plain");
    EXPECT_EQ(content(), "<3>plain\n") << "there at once";
    sink->write(16, " blanks stay ");
    sink->write(4, "one feed\n");
    sink->write(4, "many feeds\n\n\n");
    sink->write(5, "");
    sink->write(4, "in\nside\n");
    EXPECT_EQ(content(), "<3>plain\n<16> blanks stay \n<4>one feed\n<4>many feeds\n<5>\n<4>in\nside\n");
}

TEST_F(FileLogSinkTest, KnowsWhatKeptAnEntryOut)
{
    const auto sink = FileLogSink::open("/dev/full", why);
    ASSERT_TRUE(sink);
    EXPECT_EQ(sink->error(), 0);
    sink->write(3, "lost");
    EXPECT_EQ(sink->error(), ENOSPC);
}

TEST_F(FileLogSinkTest, EmptiesAnOldFile)
{
    FileLogSink::open(path, why)->write(3, "old");
    FileLogSink::open(path, why)->write(3, "new");
    EXPECT_EQ(content(), "<3>new\n");
}

TEST_F(FileLogSinkTest, DashIsStandardError)
{
    testing::internal::CaptureStderr();
    FileLogSink::open("-", why)->write(4, "seen");
    EXPECT_EQ(testing::internal::GetCapturedStderr(), "<4>seen\n");
    EXPECT_GT(std::fprintf(stderr, "%s", ""), -1) << "still open";
}

TEST_F(FileLogSinkTest, SaysWhyItCannotOpen)
{
    EXPECT_FALSE(FileLogSink::open(directory.path().toStdString() + "/missing/log", why));
    EXPECT_EQ(why, "No such file or directory");
    EXPECT_FALSE(FileLogSink::open(directory.path().toStdString(), why));
    EXPECT_EQ(why, "Is a directory");
}

} // namespace pelorus
