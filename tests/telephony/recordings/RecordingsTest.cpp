#include <gtest/gtest.h>
#include <zlib.h>

#include <fstream>
#include <random>

#include "telephony/recordings/DlfRecording.h"
#include "telephony/recordings/FramesRecording.h"
#include "telephony/recordings/RecordingKind.h"
#include "tests/support/TemporaryDirectory.h"
#include "tests/telephony/recordings/Wire.h"

namespace kelvo::test {
namespace {

class Recordings : public testing::Test {
protected:
    std::string file(const Bytes& bytes) {
        const std::string path = (directory.path() / std::to_string(_files++)).string();
        std::ofstream(path, std::ios::binary)
            .write(reinterpret_cast<const char*>(bytes.data()), static_cast<std::streamsize>(bytes.size()));
        return path;
    }
    std::string packed(const Bytes& bytes) {
        const std::string path = (directory.path() / std::to_string(_files++)).string();
        const gzFile file = gzopen(path.c_str(), "wb");
        gzwrite(file, bytes.data(), static_cast<unsigned>(bytes.size()));
        gzclose(file);
        return path;
    }

    /// The log types and codes of a recording's records: "1:b0c2 1:b17f".
    template <class Reader>
    std::string read(const std::string& path) {
        auto opened = RecordingFile::open(path);
        if (!opened) return opened.error().reason;
        Reader reader(std::move(opened).value());
        std::string text;
        times.clear();
        subscriptions.clear();
        sizes.clear();
        for (;;) {
            const auto next = reader.next();
            if (!next) return next.error().reason;
            if (!*next) break;
            const ByteView message = (*next)->message;
            char code[16];
            std::snprintf(code, sizeof code, "%d:%x", message[0], message[3] | message[4] << 8);
            text += (text.empty() ? "" : " ") + std::string(code);
            times.push_back((*next)->time);
            subscriptions.push_back((*next)->subscription);
            sizes.push_back(message.size());
        }
        damage = reader.damage();
        return text;
    }
    std::string frames(const Bytes& bytes) { return read<FramesRecording>(file(bytes)); }
    std::string dlf(const Bytes& bytes) { return read<DlfRecording>(file(bytes)); }

    TemporaryDirectory directory;
    std::vector<std::optional<wire::SystemTime>> times;
    std::vector<std::optional<std::int32_t>> subscriptions;
    std::vector<std::size_t> sizes;
    RecordingDamage damage;

private:
    int _files = 0;
};

const Bytes kServing = plainRecord(0xB0C2, kTicks, Bytes(25, 2));
const Bytes kIdle = plainRecord(0xB17F, kTicks + 800, Bytes(20, 1));
const Bytes kBlock = plainRecord(0xB0C1, kTicks + 1600, Bytes(9, 0x7E));

TEST_F(Recordings, ReadFramesBehindGarbageAndAPartialFrame) {
    Bytes bytes = {0x7E, 1, 2, 3, 0xFF, 0x7E};
    bytes += plainFrame(recordBodyOf(kServing));
    bytes += plainFrame({0x60, 0, 0});  // events, texts and answers are no records
    bytes += plainFrame(recordBodyOf(kBlock));
    EXPECT_EQ(frames(bytes), "1:b0c2 1:b0c1");
    EXPECT_EQ(sizes, (std::vector<std::size_t>{38, 22}));
    EXPECT_EQ(times[1].value() - times[0].value(), std::chrono::seconds(2));
    EXPECT_EQ(damage.damagedFrames, 1U);
}

TEST_F(Recordings, SkipDamagedFramesAndCountThem) {
    Bytes bytes = plainFrame(recordBodyOf(kServing));
    Bytes flipped = plainFrame(recordBodyOf(kIdle));
    flipped[20] ^= 4;
    bytes += flipped;
    Bytes lying = recordBodyOf(kIdle);
    lying[4] = 13;  // the second length
    bytes += plainFrame(lying);
    bytes += plainFrame({0x9E, 1, 2, 3, 4});
    bytes += plainFrame(recordBodyOf(kBlock));
    EXPECT_EQ(frames(bytes), "1:b0c2 1:b0c1");
    EXPECT_EQ(damage.damagedFrames, 2U);
    EXPECT_EQ(damage.encryptedRecords, 1U);
}

TEST_F(Recordings, TellTheSubscriptionOfAWrappedRecord) {
    Bytes wrapped = {0x98, 1, 0, 0, 2, 0, 0, 0};
    wrapped += recordBodyOf(kIdle);
    Bytes bytes = plainFrame(recordBodyOf(kServing));
    bytes += plainFrame(wrapped);
    EXPECT_EQ(frames(bytes), "1:b0c2 1:b17f");
    EXPECT_EQ(subscriptions, (std::vector<std::optional<std::int32_t>>{std::nullopt, 2}));
    EXPECT_EQ(sizes[1], 33U);
}

TEST_F(Recordings, KnowNoTimeOfAClockThatIsNotSet) {
    EXPECT_EQ(frames(plainFrame(recordBodyOf(plainRecord(0xB0C2, 800 * 60, Bytes(25))))), "1:b0c2");
    EXPECT_EQ(times[0], std::nullopt);
}

TEST_F(Recordings, ReadWhatIsPacked) {
    Bytes bytes;
    for (int i = 0; i < 5000; ++i) bytes += plainFrame(recordBodyOf(kServing));
    EXPECT_EQ(read<FramesRecording>(packed(bytes)).size(), 5000U * 7 - 1);
    EXPECT_FALSE(damage.isCut);

    const std::string path = packed(bytes);
    std::filesystem::resize_file(path, std::filesystem::file_size(path) - 20);
    EXPECT_GT(read<FramesRecording>(path).size(), 100U);
    EXPECT_TRUE(damage.isCut);
}

TEST_F(Recordings, ReadDlfFiles) {
    Bytes bytes = plainRecord(0x1FFD, 0, Bytes(149));
    bytes += kServing;
    bytes += kIdle;
    bytes += plainRecord(0x0001, kTicks, Bytes(5, '<'));  // the phone's own, whose log type a DLF file does not keep
    bytes += kBlock;
    EXPECT_EQ(dlf(bytes), "1:1ffd 1:b0c2 1:b17f 255:1 1:b0c1");
    EXPECT_EQ(sizes, (std::vector<std::size_t>{162, 38, 33, 18, 22}));
    EXPECT_EQ(damage, RecordingDamage());
}

TEST_F(Recordings, ReadTheDlfExtractOfASnapshot) {
    Bytes bytes = plainRecord(0x1FFD, 0, Bytes(149));
    bytes += kServing;  // the first of an entry lacks its log type, the others have it and some a prefix
    bytes += {1};
    bytes += kIdle;
    bytes += {0x81, 0, 1};
    bytes += kBlock;
    bytes += {255};
    bytes += plainRecord(0x0000, kTicks, Bytes(5, '<'));
    EXPECT_EQ(dlf(bytes), "1:1ffd 1:b0c2 1:b17f 1:b0c1 255:0");
    EXPECT_EQ(damage, RecordingDamage());
}

TEST_F(Recordings, FindTheNextRecordBehindADamagedStretch) {
    Bytes bytes = kServing;
    bytes += kServing;
    bytes += Bytes(1000, 0xEE);
    for (int i = 0; i < 6; ++i) bytes += kIdle;
    EXPECT_EQ(dlf(bytes), "1:b0c2 1:b0c2 1:b17f 1:b17f 1:b17f 1:b17f 1:b17f 1:b17f");
    EXPECT_EQ(damage.skippedBytes, 1000U);
    EXPECT_FALSE(damage.isCut);
}

TEST_F(Recordings, TellThatADlfFileEndsWithinARecord) {
    Bytes bytes = kServing;
    bytes += kServing;
    bytes += kIdle;
    bytes.resize(bytes.size() - 7);
    EXPECT_EQ(dlf(bytes), "1:b0c2 1:b0c2");
    EXPECT_EQ(damage.skippedBytes, 25U);
    EXPECT_TRUE(damage.isCut);
}

TEST_F(Recordings, ReadALongDlfFile) {
    Bytes bytes;
    for (int i = 0; i < 40000; ++i) bytes += kServing;
    EXPECT_EQ(dlf(bytes).size(), 40000U * 7 - 1);
    EXPECT_EQ(damage, RecordingDamage());
}

TEST_F(Recordings, AreToldByTheirContent) {
    Bytes frames(1000, 0x55);
    frames += plainFrame(recordBodyOf(kServing));  // the garbage's, and so no frame
    frames += plainFrame(recordBodyOf(kServing));
    EXPECT_EQ(recognizeRecording(frames), RecordingKind::Frames);
    EXPECT_EQ(recognizeRecording(kServing), RecordingKind::Dlf);
    EXPECT_EQ(recognizeRecording(Bytes{0xD4, 0xC3, 0xB2, 0xA1, 2, 0, 4, 0}), RecordingKind::Capture);
    EXPECT_EQ(recognizeRecording(Bytes{0xA1, 0xB2, 0x3C, 0x4D}), RecordingKind::Capture);
    EXPECT_EQ(recognizeRecording(bytesOf("bplist00")), RecordingKind::Snapshot);
    EXPECT_EQ(recognizeRecording(bytesOf("  <?xml version=\"1.0\"?>")), RecordingKind::Snapshot);
    EXPECT_EQ(recognizeRecording(Bytes{}), RecordingKind::Unknown);
    EXPECT_EQ(recognizeRecording(bytesOf("Hello, world")), RecordingKind::Unknown);
    EXPECT_EQ(recognizeRecording(packed(frames)).value(), RecordingKind::Frames);
    EXPECT_FALSE(recognizeRecording((directory.path() / "none").string()));
}

TEST_F(Recordings, AreNotSeenInNoise) {
    std::mt19937 random(4711);
    Bytes noise(1024 * 1024);
    for (std::uint8_t& byte : noise) byte = static_cast<std::uint8_t>(random());
    EXPECT_EQ(recognizeRecording(noise), RecordingKind::Unknown);
}

TEST_F(Recordings, AreNamedWhereACaptureWasExpected) {
    const std::string path = file(plainFrame(recordBodyOf(kServing)));
    EXPECT_EQ(whyNoCapture(path, "no capture"),
              path + ": this is a stream of diagnostic frames; kelvoctl import makes a capture of it");
    EXPECT_EQ(whyNoCapture(file(kServing), "no capture").substr(directory.path().string().size()),
              "/1: this is a DLF file; kelvoctl import makes a capture of it");
    EXPECT_EQ(whyNoCapture(file({1, 2, 3}), "no capture"), "no capture");
}

TEST_F(Recordings, SayWhyAFileCannotBeRead) {
    EXPECT_EQ(read<DlfRecording>("/nowhere/drive.dlf"), "/nowhere/drive.dlf cannot be read: No such file or directory");
    EXPECT_EQ(read<DlfRecording>(directory.path().string()),
              directory.path().string() + " cannot be read: Is a directory");
}

}  // namespace
}  // namespace kelvo::test
