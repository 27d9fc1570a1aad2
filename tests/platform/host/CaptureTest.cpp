#include "platform/host/Capture.h"

#include <gtest/gtest.h>
#include <sys/stat.h>

#include <filesystem>

#include "platform/system/MessagePorts.h"
#include "tests/support/CaptureFile.h"
#include "tests/support/FileSizeLimit.h"
#include "tests/support/TemporaryDirectory.h"

namespace kelvo {
namespace {

using namespace std::chrono_literals;
using test::contentsOf;
using test::TemporaryDirectory;

void u32(Bytes& bytes, std::uint32_t value) {
    for (int shift = 0; shift < 32; shift += 8) bytes.push_back(static_cast<std::uint8_t>(value >> shift));
}

/// A capture's header, little-endian: magic, version 2.4, no zone, no accuracy, snapshot length, link type.
Bytes fileHeader(std::uint32_t linkType, std::uint32_t magic = 0xa1b2c3d4, std::uint32_t snapshotLength = 65535) {
    Bytes bytes;
    for (std::uint32_t word : {magic, 0x00040002U, 0U, 0U, snapshotLength, linkType}) u32(bytes, word);
    return bytes;
}

void addPacket(Bytes& file, std::uint32_t seconds, std::uint32_t fraction, ByteView packet,
               std::optional<std::uint32_t> length = {}) {
    u32(file, seconds);
    u32(file, fraction);
    u32(file, static_cast<std::uint32_t>(packet.size()));
    u32(file, length.value_or(static_cast<std::uint32_t>(packet.size())));
    file.insert(file.end(), packet.begin(), packet.end());
}

struct Capture : testing::Test {
    std::string openingFails(const std::string& path) {
        const auto reader = CaptureReader::open(path);
        return reader ? "it opened" : reader.error().reason;
    }
    /// Reads past `good` packets of the file and says why the next one cannot be read.
    std::string readingFails(const Bytes& file, int good) {
        auto reader = CaptureReader::open(directory.write("file.pcap", file));
        if (!reader) return reader.error().reason;
        for (int i = 0; i < good; ++i) {
            const auto packet = reader->next();
            if (!packet || !packet.value()) return "too few packets";
        }
        const auto packet = reader->next();
        return packet ? "it was read" : packet.error().reason;
    }
    std::string path() { return directory.file("file.pcap"); }

    TemporaryDirectory directory;
};

TEST_F(Capture, ReadsMessagesAndTimesInOrder) {
    Bytes file = fileHeader(150);
    addPacket(file, 1000, 250, Bytes{1, 2, 3});
    addPacket(file, 1001, 999999, Bytes{4});
    auto reader = CaptureReader::open(directory.write("file.pcap", file));
    ASSERT_TRUE(reader);

    const auto first = reader->next();
    ASSERT_TRUE(first && first.value());
    EXPECT_EQ(Bytes(first.value()->bytes.begin(), first.value()->bytes.end()), (Bytes{1, 2, 3}));
    EXPECT_EQ(first.value()->time.time_since_epoch(), 1000s + 250us);
    const auto second = reader->next();
    ASSERT_TRUE(second && second.value());
    EXPECT_EQ(Bytes(second.value()->bytes.begin(), second.value()->bytes.end()), (Bytes{4}));
    EXPECT_EQ(second.value()->time.time_since_epoch(), 1001s + 999999us);
    const auto end = reader->next();
    ASSERT_TRUE(end);
    EXPECT_FALSE(end.value());
}

TEST_F(Capture, ReadsNanoseconds) {
    Bytes file = fileHeader(150, 0xa1b23c4d);
    addPacket(file, 1000, 123456789, Bytes{1});
    auto reader = CaptureReader::open(directory.write("file.pcap", file));
    ASSERT_TRUE(reader);
    const auto packet = reader->next();
    ASSERT_TRUE(packet && packet.value());
    EXPECT_EQ(packet.value()->time.time_since_epoch(), 1000s + 123456789ns);
}

TEST_F(Capture, ReadsTheOtherByteOrder) {
    const Bytes file{0xa1, 0xb2, 0xc3, 0xd4, 0, 2, 0, 4, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0xff, 0xff, 0, 0, 0, 149,  //
                     0,    0,    0,    7,    0, 0, 0, 8, 0, 0, 0, 2, 0, 0, 0, 2, 9, 9};
    auto reader = CaptureReader::open(directory.write("file.pcap", file));
    ASSERT_TRUE(reader);
    EXPECT_EQ(reader->technology(), Technology::CDMA);
    const auto packet = reader->next();
    ASSERT_TRUE(packet && packet.value());
    EXPECT_EQ(packet.value()->time.time_since_epoch(), 7s + 8us);
    EXPECT_EQ(packet.value()->bytes.size(), 2U);
}

TEST_F(Capture, NamesTheTechnologyByTheLinkType) {
    const std::pair<std::uint32_t, std::optional<Technology>> expected[] = {
        {147, Technology::IFX},   {148, Technology::GSM}, {149, Technology::CDMA}, {150, Technology::LTE},
        {151, Technology::UTRAN}, {146, std::nullopt},    {152, std::nullopt},     {1, std::nullopt},
    };
    for (const auto& [linkType, technology] : expected) {
        const auto reader = CaptureReader::open(directory.write("file.pcap", fileHeader(linkType)));
        ASSERT_TRUE(reader) << linkType;
        EXPECT_EQ(reader->technology(), technology) << linkType;
    }
}

TEST_F(Capture, AFileWithoutPacketsEndsAtOnce) {
    auto reader = CaptureReader::open(directory.write("file.pcap", fileHeader(150)));
    ASSERT_TRUE(reader);
    const auto end = reader->next();
    ASSERT_TRUE(end);
    EXPECT_FALSE(end.value());
}

TEST_F(Capture, SaysWhyAFileCannotBeOpened) {
    EXPECT_EQ(openingFails(path()), path() + " cannot be opened: No such file or directory");
    EXPECT_EQ(openingFails(directory.path()), directory.path().string() + " cannot be read: Is a directory");
    EXPECT_EQ(openingFails(directory.write("file.pcap", {})), path() + " is empty");
    EXPECT_EQ(openingFails(directory.write("file.pcap", bytesOf("<?xml version=\"1.0\"?><plist/>"))),
              path() + " is not a pcap file: unknown file format");
    EXPECT_EQ(openingFails(directory.write("file.pcap", bytesOf("ab"))).find(path() + " is not a pcap file: "), 0U);
    EXPECT_EQ(openingFails(directory.write("file.pcap", Bytes{0x0a, 0x0d, 0x0d, 0x0a, 28, 0, 0, 0, 0x4d, 0x3c})),
              path() + " is a pcapng file; captures are classic pcap files (editcap -F pcap converts it)");
}

TEST_F(Capture, ATruncatedFileFailsAtThePacketItEndsIn) {
    Bytes file = fileHeader(150);
    addPacket(file, 1, 0, Bytes{1, 2, 3});
    addPacket(file, 2, 0, Bytes{4, 5, 6});
    const std::string start = path() + " cannot be read at packet 2: ";
    file.pop_back();
    EXPECT_EQ(readingFails(file, 1).substr(0, start.size()), start);
    file.resize(24 + 16 + 3 + 15);  // within the second packet's header
    EXPECT_EQ(readingFails(file, 1).substr(0, start.size()), start);
}

TEST_F(Capture, ATruncatedFileHeaderIsNoCapture) {
    Bytes file = fileHeader(150);
    file.resize(20);
    EXPECT_EQ(readingFails(file, 0).find(path() + " is not a pcap file: truncated"), 0U);
}

TEST_F(Capture, RefusesAPacketThatWasCutWhenItWasTaken) {
    Bytes file = fileHeader(150);
    addPacket(file, 1, 0, Bytes{1, 2, 3}, 10);
    EXPECT_EQ(readingFails(file, 0), path() + " holds 3 of the 10 bytes of packet 1; captures hold whole messages");
}

TEST_F(Capture, RefusesAPacketLongerThanAnyMessage) {
    Bytes file = fileHeader(150, 0xa1b2c3d4, 262144);
    addPacket(file, 1, 0, Bytes(131072));
    addPacket(file, 1, 0, Bytes(131073));
    EXPECT_EQ(readingFails(file, 1), path() + " holds 131073 bytes in packet 2; a message has at most 131072");
}

TEST_F(Capture, ALyingPacketLengthFails) {
    Bytes file = fileHeader(150);
    for (std::uint32_t word : {1U, 0U, 0xfffffff0U, 0xfffffff0U}) u32(file, word);
    const std::string start = path() + " cannot be read at packet 1: ";
    EXPECT_EQ(readingFails(file, 0).substr(0, start.size()), start);
}

TEST_F(Capture, WritesAFileByteForByte) {
    {
        auto writer = CaptureWriter::create(OutputFile::create(path()).value(), Technology::UTRAN);
        ASSERT_TRUE(writer);
        EXPECT_TRUE(writer->append(CaptureTime(1000s + 250us + 999ns), Bytes{1, 2, 3}));
        EXPECT_TRUE(writer->append(CaptureTime(1001s), Bytes{}));
        EXPECT_TRUE(writer->appear());
    }
    Bytes expected = fileHeader(151, 0xa1b2c3d4, 131072);
    addPacket(expected, 1000, 250, Bytes{1, 2, 3});
    addPacket(expected, 1001, 0, Bytes{});
    EXPECT_EQ(contentsOf(path()), textOf(expected));
}

TEST_F(Capture, AWrittenPacketIsInTheFileAtOnce) {
    CaptureWriter writer = test::captureAt(path(), Technology::LTE);
    EXPECT_EQ(contentsOf(path()).size(), 24U);
    EXPECT_TRUE(writer.append(CaptureTime(1s), Bytes{1, 2, 3}));
    EXPECT_EQ(contentsOf(path()).size(), 24U + 16 + 3);
}

TEST_F(Capture, DoesNotAppearUntilItIsTold) {
    {
        auto writer = CaptureWriter::create(OutputFile::create(path()).value(), Technology::LTE);
        EXPECT_TRUE(writer->append(CaptureTime(1s), Bytes{1, 2, 3}));
        EXPECT_FALSE(std::filesystem::exists(path()));
    }
    EXPECT_TRUE(std::filesystem::is_empty(directory.path()));
}

TEST_F(Capture, MakesAFileThatNobodyElseCanRead) {
    const mode_t mask = ::umask(0);
    test::captureAt(path(), Technology::LTE);
    ::umask(mask);
    EXPECT_EQ(std::filesystem::status(path()).permissions(), std::filesystem::perms(0600));
}

TEST_F(Capture, SaysThatTheDiskIsFull) {
    const auto writer = CaptureWriter::create(OutputFile::create("/dev/full").value(), Technology::LTE);
    ASSERT_FALSE(writer);
    EXPECT_EQ(writer.error().reason, "/dev/full cannot be written: Can't write to stream: No space left on device");
}

TEST_F(Capture, KeepsThePacketsBeforeTheOneThatDidNotFit) {
    CaptureWriter writer = test::captureAt(path(), Technology::LTE);
    EXPECT_TRUE(writer.append(CaptureTime(1s), Bytes{1, 2, 3}));
    const std::string before = contentsOf(path());

    const auto appended = [&] {
        const test::FileSizeLimit full(before.size() + 20);
        return writer.append(CaptureTime(2s), Bytes(100));
    }();

    ASSERT_FALSE(appended);
    EXPECT_EQ(appended.error().reason, path() + " cannot be written: File too large");
    EXPECT_EQ(contentsOf(path()), before);
    EXPECT_TRUE(writer.append(CaptureTime(3s), Bytes{4}));
    EXPECT_EQ(contentsOf(path()).size(), before.size() + 16 + 1);
}

TEST_F(Capture, RefusesToWriteWhatNoReaderWouldTake) {
    CaptureWriter writer = test::captureAt(path(), Technology::LTE);
    const auto appended = writer.append(CaptureTime(1s), Bytes(kMaxMessageSize + 1));
    ASSERT_FALSE(appended);
    EXPECT_EQ(appended.error().reason, path() + " takes messages of at most 131072 bytes, not 131073");
    EXPECT_EQ(contentsOf(path()).size(), 24U);
}

TEST(Technology, HasOneNameForEachPlace) {
    EXPECT_EQ(namesOf(Technology::GSM).word, "gsm");
    EXPECT_EQ(namesOf(Technology::UTRAN).identifier, "kPLLogChannelTechnology_Oskra_UTRAN2");
    EXPECT_EQ(technologyBy(&TechnologyNames::word, std::string_view("ifx")), Technology::IFX);
    EXPECT_EQ(technologyBy(&TechnologyNames::word, std::string_view("IFX")), std::nullopt);
    EXPECT_EQ(technologyBy(&TechnologyNames::identifier, std::string_view("kPLLogChannelTechnology_Oskra_LTE")),
              Technology::LTE);
}

}  // namespace
}  // namespace kelvo
