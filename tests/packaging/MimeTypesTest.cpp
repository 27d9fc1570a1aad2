// What the desktop calls Kelvo's files, as told by Qt's reader of the shared MIME database.
#include <gtest/gtest.h>

#include <QMimeDatabase>
#include <QMimeType>

namespace {

QByteArray number(std::uint32_t value, bool bigEndian) {
    QByteArray bytes(4, '\0');
    for (int i = 0; i < 4; ++i) bytes[bigEndian ? 3 - i : i] = static_cast<char>(value >> 8 * i & 0xFF);
    return bytes;
}

QByteArray pcapHeader(std::uint32_t magic, std::uint32_t linkType, bool bigEndian) {
    return number(magic, bigEndian) + QByteArray("\2\0\4\0", 4) + QByteArray(8, '\0') + number(65535, bigEndian) +
           number(linkType, bigEndian);
}

std::string typeOf(const QString& name, const QByteArray& content) {
    return QMimeDatabase().mimeTypeForFileNameAndData(name, content).name().toStdString();
}

}  // namespace

TEST(MimeTypes, KnowACaptureByItsLinkType) {
    for (const bool bigEndian : {false, true}) {
        for (const std::uint32_t magic : {0xA1B2C3D4U, 0xA1B23C4DU}) {
            for (const std::uint32_t linkType : {147U, 148U, 149U, 150U, 151U}) {
                EXPECT_EQ(typeOf("drive.pcap", pcapHeader(magic, linkType, bigEndian)), "application/x-kelvo-capture");
                EXPECT_EQ(typeOf("drive", pcapHeader(magic, linkType, bigEndian)), "application/x-kelvo-capture");
            }
        }
        for (const std::uint32_t linkType : {1U, 146U, 152U}) {
            EXPECT_EQ(typeOf("drive", pcapHeader(0xA1B2C3D4U, linkType, bigEndian)), "application/vnd.tcpdump.pcap");
            EXPECT_EQ(typeOf("drive.pcap", pcapHeader(0xA1B2C3D4U, linkType, bigEndian)),
                      "application/vnd.tcpdump.pcap");
        }
    }
}

TEST(MimeTypes, KnowASnapshotByItsBeginning) {
    const QByteArray snapshot =
        "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n<plist version=\"1.0\">\n<dict>\n\t<key>Timestamp</key>\n"
        "\t<string>2011-03-04 09:15:02 +0000</string>\n\t<key>Data</key>\n\t<array>\n";
    EXPECT_EQ(typeOf("KelvoSnapshot-1300000000.kelvo", snapshot), "application/x-kelvo-snapshot");
    EXPECT_EQ(typeOf("renamed", snapshot), "application/x-kelvo-snapshot");
    for (const char* inside :
         {"", "<key>Timestamp</key><date>2011-03-04T09:15:02Z</date>", "<key>Data</key><array/>"}) {
        const QByteArray other = QByteArray("<plist version=\"1.0\"><dict>") + inside + "</dict></plist>\n";
        EXPECT_NE(typeOf("other.xml", other), "application/x-kelvo-snapshot") << inside;
        EXPECT_NE(typeOf("other", other), "application/x-kelvo-snapshot") << inside;
    }
}

// The database is this tree's file and what Qt brings along; they must be known before Qt looks.
int main(int argc, char** argv) {
    qputenv("XDG_DATA_HOME", KELVO_DATA_HOME);
    qputenv("XDG_DATA_DIRS", KELVO_DATA_HOME "/nothing");
    testing::InitGoogleTest(&argc, argv);
    return RUN_ALL_TESTS();
}
