#include "tests/recording/PcapFile.h"

#include <sys/stat.h>
#include <unistd.h>

namespace pelorus::test {
namespace {

class NoRecording : public RecordingFixture {};

constexpr const char* kNone = "no recording: neither pcap or pcapng, nor a snapshot, nor a DLF file";

TEST_F(NoRecording, EmptyFile)
{
    EXPECT_EQ(refusal(write("")), "the file is empty");
}

TEST_F(NoRecording, OtherFiles)
{
    EXPECT_EQ(refusal(write("Just some text.\n")), kNone);
    EXPECT_EQ(refusal(write("\n\n \t\n")), kNone);
    EXPECT_EQ(refusal(write("\xA1\xB2")), kNone);
    EXPECT_EQ(refusal(write(std::string_view("\xA1\0\xFD", 3))), kNone);
    EXPECT_EQ(refusal(write("\x7F"
                            "ELF\x02\x01\x01")),
              kNone);
    EXPECT_EQ(refusal("/proc/self/exe"), kNone);
}

TEST_F(NoRecording, MissingFile)
{
    EXPECT_EQ(refusal(directory / "missing"), "No such file or directory");
    EXPECT_EQ(refusal(write("x") + "/below"), "Not a directory");
}

TEST_F(NoRecording, Directory)
{
    EXPECT_EQ(refusal(directory), "Is a directory");
}

TEST_F(NoRecording, FileThatMustNotBeRead)
{
    const std::string path = write(PcapFile(PcapFile::kMicroseconds).bytes());
    chmod(path.c_str(), 0);
    const uid_t user = geteuid();
    if (user == 0) { // who may read everything
        std::filesystem::permissions(directory, std::filesystem::perms::all);
        ASSERT_EQ(seteuid(65534), 0);
    }
    EXPECT_EQ(refusal(path), "Permission denied");
    ASSERT_EQ(seteuid(user), 0);
}

TEST_F(NoRecording, PipeCannotBeReadTwice)
{
    int ends[2];
    ASSERT_EQ(pipe(ends), 0);
    const Bytes file = PcapFile(PcapFile::kMicroseconds).bytes();
    ASSERT_EQ(::write(ends[1], file.data(), file.size()), static_cast<ssize_t>(file.size()));
    close(ends[1]);
    EXPECT_EQ(refusal("/dev/fd/" + std::to_string(ends[0])), "no file that can be read twice");
    close(ends[0]);
}

TEST_F(NoRecording, FileNamedLikeStandardInput)
{
    EXPECT_EQ(refusal("-"), "No such file or directory");
}

} // namespace
} // namespace pelorus::test
