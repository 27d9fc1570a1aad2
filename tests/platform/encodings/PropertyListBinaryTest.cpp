#include <gtest/gtest.h>

#include <chrono>
#include <cstdint>
#include <limits>
#include <string>
#include <vector>

#include "platform/encodings/PropertyList.h"

namespace kelvo {
namespace {

using namespace std::chrono;
using namespace std::string_literals;

void appendBigEndian(std::string& out, std::uint64_t value, int size) {
    for (int i = size - 1; i >= 0; --i) out.push_back(static_cast<char>(value >> (8 * i)));
}

/// The bytes of a binary property list around given objects; the trailer's fields can be made to lie.
struct Document {
    std::vector<std::string> objects;
    std::uint64_t root = 0;
    int offsetSize = 1;
    int referenceSize = 1;

    std::string bytes() const {
        std::string out = "bplist00";
        std::vector<std::size_t> offsets;
        for (const std::string& object : objects) {
            offsets.push_back(out.size());
            out += object;
        }
        const std::size_t table = out.size();
        for (std::size_t offset : offsets) appendBigEndian(out, offset, offsetSize);
        return out + trailer(offsetSize, referenceSize, objects.size(), root, table);
    }

    static std::string trailer(int offsetSize, int referenceSize, std::uint64_t count, std::uint64_t root,
                               std::uint64_t table) {
        std::string out(6, '\0');
        out.push_back(static_cast<char>(offsetSize));
        out.push_back(static_cast<char>(referenceSize));
        for (std::uint64_t field : {count, root, table}) appendBigEndian(out, field, 8);
        return out;
    }
};

Result<Value> read(std::string_view bytes) { return readPropertyList(bytesOf(bytes)); }

/// What the objects, the first of which is the root, are read as; none when they are refused.
Value value(std::vector<std::string> objects) {
    Result<Value> result = read(Document{std::move(objects)}.bytes());
    return result ? std::move(result).value() : Value();
}

std::string reasonFor(std::string_view bytes) {
    const Result<Value> result = read(bytes);
    return result ? "(was read)" : result.error().reason;
}

std::string reason(std::vector<std::string> objects) { return reasonFor(Document{std::move(objects)}.bytes()); }

TEST(BinaryPropertyListReader, ReadsADocumentByteForByte) {
    // {"MCC": 262, "Serving": true, "Levels": [-98, 1.5]}
    const std::string bytes =
        "bplist00"
        "\xD3\x01\x02\x03\x04\x05\x06"          // 0, at 8: dictionary of three: keys 1 2 3, values 4 5 6
        "\x53MCC"                               // 1, at 15
        "\x57Serving"                           // 2, at 19
        "\x56Levels"                            // 3, at 27
        "\x11\x01\x06"                          // 4, at 34: 262 in two bytes
        "\x09"                                  // 5, at 37: true
        "\xA2\x07\x08"                          // 6, at 38: array of two
        "\x13\xFF\xFF\xFF\xFF\xFF\xFF\xFF\x9E"  // 7, at 41: -98 in eight bytes
        "\x22\x3F\xC0\x00\x00"                  // 8, at 50: 1.5 in four bytes
        "\x08\x0F\x13\x1B\x22\x25\x26\x29\x32"  // offset table, at 55
        "\x00\x00\x00\x00\x00\x00\x01\x01"
        "\x00\x00\x00\x00\x00\x00\x00\x09"
        "\x00\x00\x00\x00\x00\x00\x00\x00"
        "\x00\x00\x00\x00\x00\x00\x00\x37"s;
    const Result<Value> result = read(bytes);
    ASSERT_TRUE(result) << result.error().reason;
    EXPECT_EQ(*result, Value(Dictionary::make({{"MCC", 262}, {"Serving", true}, {"Levels", Array::make({-98, 1.5})}})));
}

TEST(BinaryPropertyListReader, RefusesEveryTruncationFromItsSignatureOn) {
    const std::string bytes =
        Document{{"\xD2\x01\x02\x03\x04"s, "\x51k"s, "\x51l"s, "\xA1\x04"s, "\x22\x00\x00\x00\x00"s}}.bytes();
    ASSERT_TRUE(read(bytes));
    for (std::size_t size = 6; size < bytes.size(); ++size) {
        EXPECT_FALSE(read(std::string_view(bytes).substr(0, size))) << "cut to " << size << " bytes";
    }
    EXPECT_EQ(*read("bplis"), Value("bplis"));  // the beginning of a signature is a word like any other
}

TEST(BinaryPropertyListReader, ReadsIntegersOfEverySize) {
    EXPECT_EQ(value({"\x10\xFF"s}), Value(255));
    EXPECT_EQ(value({"\x11\xFF\xFF"s}), Value(65535));
    EXPECT_EQ(value({"\x12\xFF\xFF\xFF\xFF"s}), Value(std::int64_t{4294967295}));
    EXPECT_EQ(value({"\x13\xFF\xFF\xFF\xFF\xFF\xFF\xFF\xFF"s}), Value(-1));
    EXPECT_EQ(value({"\x13\x80\x00\x00\x00\x00\x00\x00\x00"s}), Value(std::int64_t{INT64_MIN}));
    EXPECT_EQ(value({"\x14" + std::string(15, '\0') + "\x07"}), Value(7));
    EXPECT_EQ(value({"\x14" + std::string(16, '\xFF')}), Value(-1));
}

TEST(BinaryPropertyListReader, RefusesIntegersBeyond64Bits) {
    const std::string refused = "integer beyond 64 bits at offset 8";
    EXPECT_EQ(reason({"\x14"s + std::string(8, '\0') + std::string(8, '\xFF')}), refused);  // 2^64 - 1
    EXPECT_EQ(reason({"\x14"s + std::string(7, '\0') + "\x01" + std::string(8, '\0')}), refused);
    EXPECT_EQ(reason({"\x14"s + std::string(8, '\xFF') + std::string(8, '\0')}), refused);
    EXPECT_EQ(reason({"\x15"s + std::string(32, '\0')}), "unknown object type 0x15 at offset 8");
}

TEST(BinaryPropertyListReader, ReadsRealsOfBothSizes) {
    EXPECT_EQ(value({"\x22\xC0\x20\x00\x00"s}), Value(-2.5));
    EXPECT_EQ(value({"\x23\x3F\xB9\x99\x99\x99\x99\x99\x9A"s}), Value(0.1));
    EXPECT_EQ(value({"\x23\x7F\xF0\x00\x00\x00\x00\x00\x00"s}), Value(std::numeric_limits<double>::infinity()));
    EXPECT_EQ(reason({"\x21\x00\x00"s}), "unknown object type 0x21 at offset 8");
}

TEST(BinaryPropertyListReader, ReadsDatesAsSecondsSince2001) {
    EXPECT_EQ(value({"\x33\x00\x00\x00\x00\x00\x00\x00\x00"s}), Value(Date(sys_days(2001y / 1 / 1))));
    EXPECT_EQ(value({"\x33\xBF\xF8\x00\x00\x00\x00\x00\x00"s}), Value(Date(sys_days(2001y / 1 / 1) - 1500ms)));
}

TEST(BinaryPropertyListReader, RefusesDatesThatCannotBeWritten) {
    const std::string refused = "date outside the years 0 to 9999 at offset 8";
    EXPECT_EQ(reason({"\x33\x7F\xF8\x00\x00\x00\x00\x00\x00"s}), refused);  // not a number
    EXPECT_EQ(reason({"\x33\xFF\xF0\x00\x00\x00\x00\x00\x00"s}), refused);  // infinite
    EXPECT_EQ(reason({"\x33\x7F\xEF\xFF\xFF\xFF\xFF\xFF\xFF"s}), refused);
    EXPECT_EQ(reason({"\x33\x42\x50\x00\x00\x00\x00\x00\x00"s}), refused);  // 2^38 s, about 8,700 years
}

TEST(BinaryPropertyListReader, ReadsStringsAndData) {
    EXPECT_EQ(value({"\x50"s}), Value(""));
    EXPECT_EQ(value({"\x53"
                     "abc"s}),
              Value("abc"));
    EXPECT_EQ(value({"\x5F\x10\x10"
                     "0123456789abcdef"s}),
              Value("0123456789abcdef"));
    EXPECT_EQ(value({"\x5F\x11\x00\x03"
                     "abc"s}),
              Value("abc"));
    EXPECT_EQ(value({"\x61\x20\xAC"s}), Value("\xE2\x82\xAC"));
    EXPECT_EQ(value({"\x62\xD8\x3D\xDE\x00"s}), Value("\xF0\x9F\x98\x80"));
    EXPECT_EQ(value({"\x40"s}), Value(Bytes{}));
    EXPECT_EQ(value({"\x42\x00\xFF"s}), Value(Bytes{0, 255}));
    EXPECT_EQ(value({"\x08"s}), Value(false));
}

TEST(BinaryPropertyListReader, ReplacesWhatIsNoText) {
    EXPECT_EQ(value({"\x52\xFFz"s}), Value("\xEF\xBF\xBDz"));
    EXPECT_EQ(value({"\x62\xD8\x3D\x00z"s}), Value("\xEF\xBF\xBDz"));  // high surrogate alone
    EXPECT_EQ(value({"\x62\xDE\x00\x00z"s}), Value("\xEF\xBF\xBDz"));  // low surrogate alone
    EXPECT_EQ(value({"\x61\xD8\x3D"s}), Value("\xEF\xBF\xBD"));        // high surrogate at the end
}

TEST(BinaryPropertyListReader, ReadsKeysThatAreNotAscii) {
    const Value read = value({"\xD2\x01\x02\x03\x03"s, "\x61\x00\xE9"s, "\x52\xC3\xA8"s, "\x09"s});
    EXPECT_EQ(read, Value(Dictionary::make({{"é", true}, {"è", true}})));
}

TEST(BinaryPropertyListReader, LastOfTwoEqualKeysWins) {
    EXPECT_EQ(value({"\xD2\x01\x02\x03\x04"s,
                     "\x51"
                     "a"s,
                     "\x51"
                     "a"s,
                     "\x10\x01"s, "\x10\x02"s}),
              Value(Dictionary::make({{"a", 2}})));
}

TEST(BinaryPropertyListReader, GivesEveryReferenceAnObjectOfItsOwn) {
    const Value pair = value({"\xA2\x01\x01"s, "\xA1\x02"s, "\x10\x05"s});
    const Value expected = Array::make({Array::make({5}), Array::make({5})});
    ASSERT_EQ(pair, expected);
    EXPECT_NE((*pair.array())[0].array(), (*pair.array())[1].array());
}

TEST(BinaryPropertyListReader, ReadsWideOffsetsAndReferencesAndAnotherRoot) {
    Document document{{"\x10\x05"s, "\xA1\x00\x00\x00\x00\x00\x00\x00\x00"s}};
    document.root = 1;
    document.offsetSize = 8;
    document.referenceSize = 8;
    EXPECT_EQ(*read(document.bytes()), Value(Array::make({5})));
    document = {{"\xA1\x00\x00\x01"s, "\x10\x05"s}};
    document.offsetSize = 3;
    document.referenceSize = 3;
    EXPECT_EQ(*read(document.bytes()), Value(Array::make({5})));
}

TEST(BinaryPropertyListReader, RefusesWhatIsNoPropertyListValue) {
    EXPECT_EQ(reason({"\x00"s}), "unknown object type 0x00 at offset 8");
    EXPECT_EQ(reason({"\x0F"s}), "unknown object type 0x0f at offset 8");
    EXPECT_EQ(reason({"\x32\x00\x00\x00\x00"s}), "unknown object type 0x32 at offset 8");
    EXPECT_EQ(reason({"\x71z"s}), "unknown object type 0x71 at offset 8");
    EXPECT_EQ(reason({"\x80\x01"s}), "UID, which has no place in a property list at offset 8");
    EXPECT_EQ(reason({"\xB1\x01"s, "\x09"s}), "set, which has no place in a property list at offset 8");
    EXPECT_EQ(reason({"\xC1\x01"s, "\x09"s}), "set, which has no place in a property list at offset 8");
    EXPECT_EQ(reason({"\xE0"s}), "unknown object type 0xe0 at offset 8");
    EXPECT_EQ(reason({"\xD1\x01\x01"s, "\x10\x05"s}), "key that is not a string at offset 11");
}

TEST(BinaryPropertyListReader, RefusesObjectsThatReachPastTheEnd) {
    const std::string refused = "object that reaches past the end at offset 8";
    for (const std::string& object :
         {"\x10"s, "\x11\x00"s, "\x13\x00\x00"s, "\x14\x00"s, "\x22\x00"s, "\x23\x00"s, "\x33\x00"s, "\x42\x00"s,
          "\x52z"s, "\x62\x00z\x00"s, "\xA2\x00"s, "\xD1\x00"s, "\x5F\x10\x05zzzz"s, "\x5F\x12\xFF\xFF\xFF\xFFz"s,
          "\x6F\x13\x7F\xFF\xFF\xFF\xFF\xFF\xFF\xFFz"s, "\xAF\x13\xFF\xFF\xFF\xFF\xFF\xFF\xFF\xFFz"s,
          "\xDF\x13\x80\x00\x00\x00\x00\x00\x00\x00z"s, "\x4F\x13\x20\x00\x00\x00\x00\x00\x00\x00z"s}) {
        EXPECT_EQ(reason({object}), refused) << testing::PrintToString(object);
    }
}

TEST(BinaryPropertyListReader, RefusesCountsThatAreNoCounts) {
    const std::string refused = "object without a valid count at offset 8";
    for (const std::string& object :
         {"\x5F"s, "\x5F\x22\x00\x00\x00\x00"s, "\x5F\x11\x00"s, "\x5F\x14zzzzzzzzzzzzzzzzzzz"s, "\xAF\x09"s}) {
        EXPECT_EQ(reason({object}), refused) << testing::PrintToString(object);
    }
}

TEST(BinaryPropertyListReader, RefusesReferencesAndOffsetsThatLeadNowhere) {
    EXPECT_EQ(reason({"\xA1\x01"s}), "reference to an object that does not exist at offset 9");
    EXPECT_EQ(reason({"\xD1\x01\x07"s, "\x51k"s}), "reference to an object that does not exist at offset 10");
    EXPECT_EQ(reason({"\xD1\x00\x00"s}), "key that is not a string at offset 8");
    const auto withOffset = [](char offset) { return "bplist00\x09"s + offset + Document::trailer(1, 1, 1, 0, 9); };
    EXPECT_EQ(*read(withOffset(8)), Value(true));
    EXPECT_EQ(reasonFor(withOffset(7)), "object offset outside the document at offset 9");
    EXPECT_EQ(reasonFor(withOffset(0)), "object offset outside the document at offset 9");
    EXPECT_EQ(reasonFor(withOffset(9)), "object offset outside the document at offset 9");
    EXPECT_EQ(reasonFor("bplist00\x09\xFF\xFF\xFF\xFF\xFF\xFF\xFF\xFF"s + Document::trailer(8, 1, 1, 0, 9)),
              "object offset outside the document at offset 9");
}

TEST(BinaryPropertyListReader, RefusesATrailerThatLies) {
    const auto with = [](int offsetSize, int referenceSize, std::uint64_t count, std::uint64_t root,
                         std::uint64_t table) {
        return reasonFor("bplist00\x09\x08"s + Document::trailer(offsetSize, referenceSize, count, root, table));
    };
    EXPECT_EQ(with(1, 1, 1, 0, 9), "(was read)");
    EXPECT_EQ(with(0, 1, 1, 0, 9), "impossible integer sizes in the trailer at offset 16");
    EXPECT_EQ(with(9, 1, 1, 0, 9), "impossible integer sizes in the trailer at offset 16");
    EXPECT_EQ(with(1, 0, 1, 0, 9), "impossible integer sizes in the trailer at offset 16");
    EXPECT_EQ(with(1, 9, 1, 0, 9), "impossible integer sizes in the trailer at offset 16");
    EXPECT_EQ(with(1, 1, 1, 0, 8), "offset table outside the document at offset 34");
    EXPECT_EQ(with(1, 1, 1, 0, 10), "offset table outside the document at offset 34");
    EXPECT_EQ(with(1, 1, 1, 0, UINT64_MAX), "offset table outside the document at offset 34");
    EXPECT_EQ(with(1, 1, 0, 0, 9), "number of objects that does not match the offset table at offset 18");
    EXPECT_EQ(with(1, 1, 2, 0, 9), "number of objects that does not match the offset table at offset 18");
    EXPECT_EQ(with(2, 1, 1, 0, 9), "number of objects that does not match the offset table at offset 18");
    EXPECT_EQ(with(8, 1, 0x2000000000000001, 0, 9),
              "number of objects that does not match the offset table at offset 18");
    EXPECT_EQ(with(1, 1, 1, 1, 9), "root object out of range at offset 26");
}

TEST(BinaryPropertyListReader, RefusesOtherVersionsAndDocumentsCutShort) {
    EXPECT_EQ(reasonFor("bplist01"s + std::string(40, '\0')), "unknown version of binary property list at offset 0");
    EXPECT_EQ(reasonFor("bplist"), "binary property list cut short at offset 6");
    EXPECT_EQ(reasonFor("bplist00"), "binary property list cut short at offset 8");
    EXPECT_EQ(reasonFor("bplist00"s + std::string(31, '\0')), "binary property list cut short at offset 39");
}

TEST(BinaryPropertyListReader, RefusesObjectsThatContainThemselves) {
    EXPECT_EQ(reason({"\xA1\x00"s}), "object that contains itself at offset 8");
    EXPECT_EQ(reason({"\xA1\x01"s, "\xD1\x02\x00"s, "\x51k"s}), "object that contains itself at offset 8");
}

Document nested(std::uint64_t levels) {
    Document document;
    document.offsetSize = 2;
    document.referenceSize = 2;
    for (std::uint64_t i = 1; i < levels; ++i) {
        std::string array = "\xA1";
        appendBigEndian(array, i, 2);
        document.objects.push_back(array);
    }
    document.objects.push_back("\xA0");
    return document;
}

TEST(BinaryPropertyListReader, AcceptsTheDeepestTreeAndRefusesOneLevelMore) {
    Value expected = Array::make();
    for (int i = 1; i < 512; ++i) expected = Array::make({expected});
    const Result<Value> deepest = read(nested(512).bytes());
    ASSERT_TRUE(deepest) << deepest.error().reason;
    EXPECT_EQ(*deepest, expected);
    EXPECT_EQ(reasonFor(nested(513).bytes()),
              "nested deeper than 512 levels at offset 2569");  // entry 512 of the table
    EXPECT_EQ(reasonFor(nested(10000).bytes()).substr(0, 29), "nested deeper than 512 levels");
}

TEST(BinaryPropertyListReader, StopsObjectsThatMultiplyByReferences) {
    std::vector<std::string> objects;
    for (char i = 1; i <= 100; ++i) objects.push_back("\xA2"s + i + i);  // twice the next array
    objects.push_back("\xA0");
    Document document{objects};
    document.offsetSize = 2;
    EXPECT_EQ(reasonFor(document.bytes()).substr(0, 42), "shared objects that multiply beyond measur");
}

TEST(BinaryPropertyListReader, StopsTextAndDataThatMultiplyByReferences) {
    for (const char marker : {'\x5F', '\x4F'}) {
        std::string many = "\xAF\x11\x27\x10"s;  // 10,000 references to a megabyte
        for (int i = 0; i < 10000; ++i) many += "\x00\x01"s;
        Document document{{many, std::string(1, marker) + "\x12\x00\x10\x00\x00"s + std::string(1 << 20, 'x')}};
        document.offsetSize = 4;
        document.referenceSize = 2;
        EXPECT_EQ(reasonFor(document.bytes()), "shared objects that multiply beyond measure at offset 20012");
    }
}

// A hundred bytes that stand for as many thousand values, and twelve kilobytes that stand for megabytes of text.
TEST(BinaryPropertyListReader, LetsASmallDocumentGrowToAFewMegabytesOnly) {
    std::vector<std::string> doubling;
    for (char i = 1; i <= 16; ++i) doubling.push_back("\xA2"s + i + i);
    doubling.push_back("\xA0");
    EXPECT_EQ(reasonFor(Document{doubling}.bytes()).substr(0, 42), "shared objects that multiply beyond measur");

    std::string many = "\xAF\x11\x30\x00"s + std::string(12'288, '\x01');
    Document text{{many, "\x5F\x11\x04\x00"s + std::string(1024, 'x')}};
    text.offsetSize = 2;
    EXPECT_EQ(reasonFor(text.bytes()).substr(0, 42), "shared objects that multiply beyond measur");
}

TEST(BinaryPropertyListReader, LeavesRoomForTheSharingOfEveryKey) {
    std::string rows = "\xAF\x11\x07\xD0"s;  // 2,000 rows that all name their one column by the same object
    std::vector<std::string> objects = {"",
                                        "\x5F\x10\x20"
                                        "a column with a long name indeed",
                                        "\x09"};
    for (std::uint64_t i = 0; i < 2000; ++i) {
        appendBigEndian(rows, objects.size(), 2);
        objects.push_back("\xD1\x00\x01\x00\x02"s);
    }
    objects[0] = rows;
    Document document{objects};
    document.offsetSize = document.referenceSize = 2;
    const Result<Value> result = read(document.bytes());
    ASSERT_TRUE(result) << result.error().reason;
    EXPECT_EQ((*(*result->array())[1999].dictionary())["a column with a long name indeed"], Value(true));
}

TEST(BinaryPropertyListReader, ReadsALargeDocumentWithoutSharing) {
    Document document{{"\xAF\x12\x00\x1E\x84\x80"s}};  // 2,000,000 elements
    document.offsetSize = 4;
    document.referenceSize = 4;
    for (std::uint64_t i = 1; i <= 2000000; ++i) appendBigEndian(document.objects[0], i, 4);
    document.objects.resize(2000001, "\x09");
    const Result<Value> result = read(document.bytes());
    ASSERT_TRUE(result) << result.error().reason;
    EXPECT_EQ(result->array()->size(), 2000000U);
}

}  // namespace
}  // namespace kelvo
