#pragma once

#include "platform/PropertyList.h"
#include "platform/recording/PcapRecording.h"
#include "platform/recording/Recording.h"
#include "tests/recording/BytesBuilder.h"

#include <filesystem>
#include <fstream>
#include <gmock/gmock.h>

namespace pelorus::test {

using namespace std::chrono_literals;

/// Files in a directory of their own.
class RecordingFixture : public testing::Test {
protected:
    RecordingFixture()
    {
        std::string pattern = (std::filesystem::temp_directory_path() / "pelorus-test-XXXXXX").string();
        directory = mkdtemp(pattern.data());
    }
    ~RecordingFixture() override { std::filesystem::remove_all(directory); }

    std::string write(const Bytes& content, const std::string& name = "recording") const
    {
        const std::string path = directory / name;
        std::filesystem::remove(path); // a new file is not flushed to the disk as one cut to nothing is
        std::ofstream file(path, std::ofstream::binary);
        file.write(reinterpret_cast<const char*>(content.data()),
                   static_cast<std::streamsize>(content.size()));
        return path;
    }
    std::string write(std::string_view text) const { return write(BytesBuilder().text(text).bytes()); }

    /// Reads a recording to its end; what it says on the way is in `why`.
    std::vector<Bytes> readAll(const std::string& path)
    {
        why.clear();
        times.clear();
        std::vector<Bytes> messages;
        const auto reader = RecordingReader::open(path, why);
        if (!reader)
            return messages;
        RecordedMessage one;
        for (;;) {
            switch (reader->next(one)) {
            case RecordingReader::Next::message:
                messages.emplace_back(one.bytes.begin(), one.bytes.end());
                times.push_back(one.time);
                break;
            case RecordingReader::Next::failed:
                why = reader->why();
                return messages;
            case RecordingReader::Next::end:
                return messages;
            }
        }
    }
    /// Why a file is no recording; empty when it is one.
    std::string refusal(const std::string& path)
    {
        std::string reason;
        const auto reader = RecordingReader::open(path, reason);
        EXPECT_EQ(reader == nullptr, !reason.empty());
        EXPECT_EQ(reason.find('\n'), std::string::npos);
        EXPECT_EQ(reason.find(path), std::string::npos);
        return reason;
    }

    std::filesystem::path directory;
    std::string why;
    std::vector<RecordedTime> times;
};

constexpr RecordedTime at(std::int64_t seconds, std::int64_t nanoseconds = 0)
{
    return RecordedTime(std::chrono::seconds(seconds) + std::chrono::nanoseconds(nanoseconds));
}

} // namespace pelorus::test
