#include "tests/recording/PcapFile.h"

namespace pelorus::test {
namespace {

/// Whatever a file holds, reading it ends, and gives no more than the file has.
class HostileRecording : public RecordingFixture {
protected:
    void readSomehow(const Bytes& content)
    {
        std::size_t total = 0;
        for (const Bytes& one : readAll(write(content)))
            total += one.size();
        // A DLF record gains a log-type byte; property lists hold data as base64 or as it is.
        EXPECT_LE(total, 2 * content.size());
    }
    void readPrefixes(const Bytes& content)
    {
        for (std::size_t length = 0; length <= content.size(); ++length)
            readSomehow(startOf(content, length));
    }
    void readChanged(const Bytes& content)
    {
        for (std::size_t place = 0; place < content.size(); ++place)
            for (const unsigned value : {0x00U, 0x01U, 0x7FU, 0x80U, 0xFFU}) {
                Bytes changed = content;
                changed[place] = static_cast<std::byte>(value);
                readSomehow(changed);
            }
    }
    void readRandom(const Bytes& start)
    {
        for (int round = 0; round < 500; ++round) {
            BytesBuilder content;
            content.raw(start);
            for (unsigned count = random() % 600; count > 0; --count)
                content.u8(random());
            readSomehow(content.bytes());
        }
    }
    unsigned random()
    {
        seed = seed * 1664525 + 1013904223;
        return seed >> 16;
    }
    std::uint32_t seed = 4711;

    static Bytes pcap()
    {
        PcapFile file(PcapFile::kNanoseconds);
        file.packet(1336123800, 1, message(1, 0xB179, "abc"))
            .packet(1336123801, 2, prefixed(message(0xFF, 1)));
        return file.bytes();
    }
    static Bytes pcapng()
    {
        PcapngFile file;
        file.packet(1'336'123'800'000'001, message(1, 0xB179, "abc"));
        return file.bytes();
    }
    static Bytes snapshot(PropertyListForm form)
    {
        const auto messages =
            makeData(BytesBuilder().raw(message(1, 0xB179)).raw(prefixed(message(0xFF, 1, "x"))).bytes());
        const Value entry =
            makeDictionary({{"DisplayState", messages}, {"Date", "2012-05-04 09:30:00 +0000"}});
        return serializePropertyList(
                   makeDictionary({{"Timestamp", "2012-05-04 09:30:00 +0000"}, {"Data", makeArray({entry})}}),
                   form)
            .value();
    }
    static Bytes dlf()
    {
        return BytesBuilder()
            .u16(161)
            .u16(0x1FFD)
            .zeros(157)
            .raw(record(0xB179, "abc"))
            .raw(prefixed(message(0xFF, 1, "defg")))
            .raw(message(1, 0xB180))
            .bytes();
    }
};

TEST_F(HostileRecording, PrefixesAndChangedBytesOfAPcap)
{
    readPrefixes(pcap());
    readChanged(pcap());
}

TEST_F(HostileRecording, PrefixesAndChangedBytesOfAPcapng)
{
    readPrefixes(pcapng());
    readChanged(pcapng());
}

TEST_F(HostileRecording, PrefixesAndChangedBytesOfASnapshot)
{
    for (const PropertyListForm form : {PropertyListForm::xml, PropertyListForm::binary}) {
        readPrefixes(snapshot(form));
        readChanged(snapshot(form));
    }
}

TEST_F(HostileRecording, PrefixesAndChangedBytesOfADlf)
{
    readPrefixes(dlf());
    readChanged(dlf());
}

TEST_F(HostileRecording, RandomBytesBehindEachMark)
{
    readRandom({});
    readRandom(PcapFile(PcapFile::kMicroseconds).bytes());
    readRandom(PcapngFile().bytes());
    readRandom(BytesBuilder().text("bplist00").bytes());
    readRandom(BytesBuilder().text("<plist version=\"1.0\">").bytes());
    readRandom(BytesBuilder().u16(161).u16(0x1FFD).zeros(157).bytes());
}

TEST_F(HostileRecording, DlfThatInvitesToGuessIsReadInReasonableTime)
{
    BytesBuilder file;
    file.u16(161).u16(0x1FFD).zeros(157);
    for (int byte = 0; byte < 1'000'000; ++byte)
        file.u8(byte % 3 == 0 ? 0x81 : byte % 3 == 1 ? 0x01 : 0xFF);
    readSomehow(file.bytes());
    BytesBuilder ones;
    ones.u16(161).u16(0x1FFD).zeros(157);
    for (int byte = 0; byte < 1'000'000; ++byte)
        ones.u8(0x01);
    readSomehow(ones.bytes());
}

TEST_F(HostileRecording, RandomRawMessages)
{
    for (int round = 0; round < 500; ++round) {
        BytesBuilder messages;
        for (unsigned count = random() % 300; count > 0; --count)
            messages.u8(random() % 16);
        readSomehow(
            serializePropertyList(
                makeDictionary(
                    {{"Timestamp", "x"},
                     {"Data", makeArray({makeDictionary({{"DisplayState", makeData(messages.bytes())}})})}}),
                PropertyListForm::binary)
                .value());
    }
}

} // namespace
} // namespace pelorus::test
