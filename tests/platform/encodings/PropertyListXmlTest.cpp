#include <gtest/gtest.h>

#include <chrono>
#include <cmath>
#include <cstdint>
#include <limits>
#include <string>

#include "platform/encodings/PropertyList.h"

namespace kelvo {
namespace {

using namespace std::chrono;
using namespace std::string_literals;

Result<Value> read(std::string_view text) { return readPropertyList(bytesOf(text)); }

/// What the one value inside <plist> is read as; none when it is refused.
Value value(std::string_view element) {
    Result<Value> result = read("<plist version=\"1.0\">" + std::string(element) + "</plist>");
    return result ? std::move(result).value() : Value();
}

std::string reason(std::string_view text) {
    const Result<Value> result = read(text);
    return result ? "(was read)" : result.error().reason;
}

std::string written(const Value& value) {
    const Result<Bytes> bytes = writeXmlPropertyList(value);
    return bytes ? std::string(textOf(*bytes)) : "(refused) " + bytes.error().reason;
}

std::string document(std::string_view body) {
    return "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n<plist version=\"1.0\">\n" + std::string(body) + "</plist>\n";
}

std::string repeated(std::string_view text, int count) {
    std::string all;
    for (int i = 0; i < count; ++i) all += text;
    return all;
}

Value nestedArrays(int levels) {
    Value value = Array::make();
    for (int i = 1; i < levels; ++i) value = Array::make({value});
    return value;
}

constexpr std::string_view kDocument = R"(<?xml version="1.0" encoding="UTF-8"?>
<!DOCTYPE plist PUBLIC "-//Example//DTD PLIST 1.0//EN" "http://example.com/PropertyList-1.0.dtd">
<plist version="1.0">
<!-- what a telephony service may send -->
<dict>
    <key>Name</key>     <string>Cell &amp; neighbours</string>
    <key>Count</key>    <integer>-7</integer>
    <key>Level</key>    <real>-98.25</real>
    <key>Serving</key>  <true/>
    <key>Barred</key>   <false/>
    <key>Seen</key>     <date>2011-03-04T09:15:02Z</date>
    <key>Raw</key>      <data>AP+A
                              fw==</data>
    <key>Bands</key>    <array><integer>1</integer><string>8</string></array>
</dict>
</plist>)";

Value documentValue() {
    return Dictionary::make({{"Name", "Cell & neighbours"},
                             {"Count", -7},
                             {"Level", -98.25},
                             {"Serving", true},
                             {"Barred", false},
                             {"Seen", Date(sys_days(2011y / 3 / 4) + 9h + 15min + 2s)},
                             {"Raw", Bytes{0x00, 0xFF, 0x80, 0x7F}},
                             {"Bands", Array::make({1, "8"})}});
}

TEST(XmlPropertyListReader, ReadsEveryKind) {
    const Result<Value> result = read(kDocument);
    ASSERT_TRUE(result) << result.error().reason;
    EXPECT_EQ(*result, documentValue());
}

TEST(XmlPropertyListReader, KeepsTheOrderOfKeys) {
    const Value dictionary = value("<dict><key>b</key><true/><key>a</key><true/><key>c</key><true/></dict>");
    std::string order;
    for (const auto& entry : *dictionary.dictionary()) order += entry.key;
    EXPECT_EQ(order, "bac");
}

TEST(XmlPropertyListReader, LastOfTwoEqualKeysWins) {
    EXPECT_EQ(value("<dict><key>a</key><string>x</string><key>a</key><integer>2</integer></dict>"),
              Value(Dictionary::make({{"a", 2}})));
}

TEST(XmlPropertyListReader, AcceptsAValueWithoutThePlistElementAroundIt) {
    EXPECT_EQ(*read("<string>GetTechnology</string>"), Value("GetTechnology"));
    EXPECT_EQ(*read("  <?xml version=\"1.0\"?>\n<array/>\n"), Value(Array::make()));
}

TEST(XmlPropertyListReader, ReadsEmptyElementsAsEmptyValues) {
    EXPECT_EQ(value("<string/>"), Value(""));
    EXPECT_EQ(value("<string></string>"), Value(""));
    EXPECT_EQ(value("<array></array>"), Value(Array::make()));
    EXPECT_EQ(value("<dict/>"), Value(Dictionary::make()));
    EXPECT_EQ(value("<data/>"), Value(Bytes{}));
    EXPECT_EQ(value("<dict><key/><true/></dict>"), Value(Dictionary::make({{"", true}})));
}

TEST(XmlPropertyListReader, KeepsWhiteSpaceInStrings) {
    EXPECT_EQ(value("<string> </string>"), Value(" "));
    EXPECT_EQ(value("<string>\n\ta b \n</string>"), Value("\n\ta b \n"));
    EXPECT_EQ(value("<string>a\r\nb\rc</string>"), Value("a\nb\nc"));
}

TEST(XmlPropertyListReader, JoinsTheTextAroundCommentsAndCharacterData) {
    EXPECT_EQ(value("<string>a<!-- <b> --> <![CDATA[<&amp;]]>&lt;c</string>"), Value("a <&amp;<c"));
    EXPECT_EQ(value("<string> <![CDATA[]]></string>"), Value(" "));
    EXPECT_EQ(*read("<?xml version=\"1.0\"?><string>a<?pi?> <?pi?>b</string>"), Value("a b"));
    EXPECT_EQ(*read("<string> <?pi?></string>"), Value(" "));
}

TEST(XmlPropertyListReader, ResolvesReferences) {
    EXPECT_EQ(value("<string>&lt;&gt;&amp;&quot;&apos;</string>"), Value("<>&\"'"));
    EXPECT_EQ(value("<string>&#65;&#x42;&#13;&#xe9;&#x1F600;</string>"), Value("AB\r\xC3\xA9\xF0\x9F\x98\x80"));
    EXPECT_EQ(value("<dict><key>a&amp;b</key><true/></dict>"), Value(Dictionary::make({{"a&b", true}})));
}

TEST(XmlPropertyListReader, RefusesReferencesToNothing) {
    for (const std::string bad :
         {"&unknown;", "&", "&amp", "&;", "&#;", "&#x;", "&#0;", "&#xD800;", "&#x110000;", "&#1x;"}) {
        EXPECT_EQ(reason("<string>a" + bad + "</string>"),
                  "unknown entity or character reference in the text at offset 8")
            << bad;
    }
}

TEST(XmlPropertyListReader, FollowsNoEntityOfADocumentType) {
    EXPECT_EQ(reason("<!DOCTYPE plist [<!ENTITY x SYSTEM \"file:///etc/hostname\">]><string>&x;</string>"),
              "unknown entity or character reference in the text at offset 68");
    EXPECT_EQ(reason("<!DOCTYPE plist [<!ENTITY x \"xx\"><!ENTITY y \"&x;&x;\">]><string>&y;</string>"),
              "unknown entity or character reference in the text at offset 63");
}

TEST(XmlPropertyListReader, ReadsIntegersOf64Bits) {
    EXPECT_EQ(value("<integer>0</integer>"), Value(0));
    EXPECT_EQ(value("<integer> +42\n</integer>"), Value(42));
    EXPECT_EQ(value("<integer>0x1aF</integer>"), Value(431));
    EXPECT_EQ(value("<integer>-0x10</integer>"), Value(-16));
    EXPECT_EQ(value("<integer>9223372036854775807</integer>"), Value(std::int64_t{INT64_MAX}));
    EXPECT_EQ(value("<integer>-9223372036854775808</integer>"), Value(std::int64_t{INT64_MIN}));
}

TEST(XmlPropertyListReader, RefusesWhatIsNoIntegerOf64Bits) {
    for (const std::string bad :
         {"", " ", "-", "+", "0x", "12x", "1 2", "1.5", "--1", "+-1", "0xg", "9223372036854775808",
          "-9223372036854775809", "0xFFFFFFFFFFFFFFFF", "99999999999999999999999"}) {
        EXPECT_EQ(reason("<integer>" + bad + "</integer>"), "<integer> that holds no valid integer at offset 1") << bad;
    }
}

TEST(XmlPropertyListReader, ReadsReals) {
    EXPECT_EQ(value("<real>1</real>"), Value(1.0));
    EXPECT_EQ(value("<real>-1.5e3</real>"), Value(-1500.0));
    EXPECT_EQ(value("<real> +.25 </real>"), Value(0.25));
    const double infinity = std::numeric_limits<double>::infinity();
    for (const std::string name : {"inf", "+inf", "infinity", "+infinity", "INF"}) {
        EXPECT_EQ(value("<real>" + name + "</real>"), Value(infinity)) << name;
    }
    EXPECT_EQ(value("<real>-infinity</real>"), Value(-infinity));
    EXPECT_TRUE(std::isnan(value("<real>nan</real>").number()->real()));
}

TEST(XmlPropertyListReader, RefusesWhatIsNoReal) {
    for (const std::string bad : {"", "x", "1,5", "1e", "0x10", "+-1", "1e999", "1.5 dB"}) {
        EXPECT_EQ(reason("<real>" + bad + "</real>"), "<real> that holds no valid real at offset 1") << bad;
    }
}

TEST(XmlPropertyListReader, RefusesDatesThatDoNotExist) {
    for (const std::string bad :
         {"", "2011-03-04", "2011-03-04T09:15:02", "2011-02-29T00:00:00Z", "2011-13-01T00:00:00Z",
          "2011-00-01T00:00:00Z", "2011-03-04T24:00:00Z", "2011-03-04T09:60:00Z", "2011-03-04T09:15:60Z",
          "2011-03-04T09:15:02+0100", "20110304T091502Z"}) {
        EXPECT_EQ(reason("<date>" + bad + "</date>"), "<date> that holds no valid date at offset 1") << bad;
    }
    EXPECT_EQ(value("<date> 2012-02-29T23:59:59Z </date>"), Value(Date(sys_days(2012y / 2 / 29) + 23h + 59min + 59s)));
    EXPECT_EQ(value("<date>1969-12-31T23:59:59Z</date>"), Value(Date(-1s)));
}

TEST(XmlPropertyListReader, ReadsBase64WithWhiteSpaceAnywhere) {
    EXPECT_EQ(value("<data>\n\tQU\n\tJD RA = =\n</data>"), Value(Bytes{'A', 'B', 'C', 'D'}));
    EXPECT_EQ(value("<data>+/8=</data>"), Value(Bytes{0xFB, 0xFF}));
}

TEST(XmlPropertyListReader, RefusesBrokenBase64) {
    for (const std::string bad :
         {"Q", "QU", "QUJ", "QUJDR", "Q===", "====", "=", "QQ=Q", "QQ==Q", "QQ==QQ==", "QQ===", "QU*D", "QU-_"}) {
        EXPECT_EQ(reason("<data>" + bad + "</data>"), "<data> that holds no valid data at offset 1") << bad;
    }
}

TEST(XmlPropertyListReader, NamesWhatIsWrongAndWhere) {
    EXPECT_EQ(reason("<dict><key>a</key></dict>"), "key without a value at offset 7");
    EXPECT_EQ(reason("<dict><key>a</key><key>b</key><true/></dict>"), "key without a value at offset 7");
    EXPECT_EQ(reason("<dict><true/></dict>"), "value without a key at offset 7");
    EXPECT_EQ(reason("<dict><key>a</key><true/><true/></dict>"), "value without a key at offset 26");
    EXPECT_EQ(reason("<dict>a<key>a</key><true/></dict>"), "text where none belongs at offset 6");
    EXPECT_EQ(reason("<array> x <true/></array>"), "text where none belongs at offset 7");
    EXPECT_EQ(reason("<true>yes</true>"), "text where none belongs at offset 6");
    EXPECT_EQ(reason("<true><false/></true>"), "element inside a boolean at offset 7");
    EXPECT_EQ(reason("<string>a<b/></string>"), "element inside <string> at offset 10");
    EXPECT_EQ(reason("<string><b/></string>"), "element inside <string> at offset 9");
    EXPECT_EQ(reason("<dict><key><b/></key><true/></dict>"), "element inside <key> at offset 12");
    EXPECT_EQ(reason("<array><set/></array>"), "unknown element <set> at offset 8");
    EXPECT_EQ(reason("<plist><key>a</key></plist>"), "unknown element <key> at offset 8");
    EXPECT_EQ(reason("<plist><plist><true/></plist></plist>"), "unknown element <plist> at offset 8");
    EXPECT_EQ(reason("<html/>"), "unknown element <html> at offset 1");
    EXPECT_EQ(reason("<plist></plist>"), "no value in the document at offset 1");
    EXPECT_EQ(reason("<!-- nothing -->"), "no value in the document at offset 0");
    EXPECT_EQ(reason("<plist><true/><true/></plist>"), "second root value at offset 15");
    EXPECT_EQ(reason("<true/><true/>"), "second root value at offset 8");
    EXPECT_EQ(reason("<true/>garbage"), "text where none belongs at offset 7");
    EXPECT_EQ(reason("<plist>a<true/></plist>"), "text where none belongs at offset 7");
    EXPECT_EQ(reason("<array></dict>"), "not well-formed XML at offset 9: Start-end tags mismatch");
    EXPECT_EQ(reason("<" + std::string(1000, 'n') + "/>"),
              "unknown element <" + std::string(32, 'n') + "> at offset 1");
}

TEST(XmlPropertyListReader, RefusesADocumentWithNul) {
    EXPECT_EQ(reason("<string>a\0b</string>"s), "not a property list: NUL at offset 9");
    EXPECT_EQ(reason("<true/>\0<garbage"s), "not a property list: NUL at offset 7");
}

TEST(XmlPropertyListReader, RefusesEveryTruncation) {
    for (std::size_t size = 0; size < kDocument.size(); ++size) {
        EXPECT_FALSE(read(kDocument.substr(0, size))) << "cut to " << size << " bytes";
    }
}

TEST(XmlPropertyListReader, ReplacesBytesThatAreNotUtf8) {
    EXPECT_EQ(value("<string>a\xFF\xC3z&amp;\xE2\x82</string>"),
              Value("a\xEF\xBF\xBD\xEF\xBF\xBDz&\xEF\xBF\xBD\xEF\xBF\xBD"));
    EXPECT_EQ(value("<dict><key>\x80</key><true/></dict>"), Value(Dictionary::make({{"\xEF\xBF\xBD", true}})));
}

TEST(XmlPropertyListReader, ReadsUtf16InBothByteOrdersAndUtf8WithAMark) {
    const std::string ascii = "<?xml version=\"1.0\" encoding=\"UTF-16\"?><string>x";
    std::string little;
    std::string big;
    for (char c : ascii) little += {c, '\0'}, big += {'\0', c};
    for (char c : "\xE9\x00<\0/\0s\0t\0r\0i\0n\0g\0>\0"s) little += c;
    for (char c : "\x00\xE9\0<\0/\0s\0t\0r\0i\0n\0g\0>"s) big += c;
    const Value expected("x\xC3\xA9");
    EXPECT_EQ(*read("\xFF\xFE" + little), expected);
    EXPECT_EQ(*read("\xFE\xFF" + big), expected);
    EXPECT_EQ(*read(little), expected);
    EXPECT_EQ(*read(big), expected);
    EXPECT_EQ(*read("\xEF\xBB\xBF<string>x\xC3\xA9</string>"), expected);
    EXPECT_EQ(reason("\xFF\xFE" + little.substr(0, little.size() - 1)).substr(0, 19), "not well-formed XML");
}

TEST(XmlPropertyListReader, AcceptsTheDeepestTreeAndRefusesOneLevelMore) {
    const auto nested = [](int levels) { return repeated("<array>", levels) + repeated("</array>", levels); };
    const Result<Value> deepest = read(nested(512));
    ASSERT_TRUE(deepest) << deepest.error().reason;
    EXPECT_EQ(*deepest, nestedArrays(512));
    EXPECT_EQ(reason(nested(513)), "nested deeper than 512 levels at offset 3585");
    EXPECT_EQ(reason(repeated("<dict><key>a</key>", 513) + "<true/>" + repeated("</dict>", 513)),
              "nested deeper than 512 levels at offset 9217");
}

TEST(XmlPropertyListReader, RefusesAMillionLevels) {
    EXPECT_EQ(reason(repeated("<array>", 1000000) + repeated("</array>", 1000000)),
              "nested deeper than 512 levels at offset 3585");
    EXPECT_EQ(reason(repeated("<array>", 1000000)).substr(0, 19), "not well-formed XML");
}

TEST(XmlPropertyListWriter, WritesEveryKindForPeopleToRead) {
    EXPECT_EQ(written(documentValue()), document("<dict>\n"
                                                 "\t<key>Name</key>\n"
                                                 "\t<string>Cell &amp; neighbours</string>\n"
                                                 "\t<key>Count</key>\n"
                                                 "\t<integer>-7</integer>\n"
                                                 "\t<key>Level</key>\n"
                                                 "\t<real>-98.25</real>\n"
                                                 "\t<key>Serving</key>\n"
                                                 "\t<true/>\n"
                                                 "\t<key>Barred</key>\n"
                                                 "\t<false/>\n"
                                                 "\t<key>Seen</key>\n"
                                                 "\t<date>2011-03-04T09:15:02Z</date>\n"
                                                 "\t<key>Raw</key>\n"
                                                 "\t<data>\n"
                                                 "\tAP+Afw==\n"
                                                 "\t</data>\n"
                                                 "\t<key>Bands</key>\n"
                                                 "\t<array>\n"
                                                 "\t\t<integer>1</integer>\n"
                                                 "\t\t<string>8</string>\n"
                                                 "\t</array>\n"
                                                 "</dict>\n"));
}

TEST(XmlPropertyListWriter, WritesEmptyValues) {
    EXPECT_EQ(written(""), document("<string></string>\n"));
    EXPECT_EQ(written(Array::make()), document("<array/>\n"));
    EXPECT_EQ(written(Dictionary::make()), document("<dict/>\n"));
    EXPECT_EQ(written(Bytes{}), document("<data></data>\n"));
}

TEST(XmlPropertyListWriter, WritesDataInLinesOf76Characters) {
    EXPECT_EQ(written(Bytes(58, 0)), document("<data>\n" + std::string(76, 'A') + "\nAA==\n</data>\n"));
    EXPECT_EQ(written(Bytes(57, 0xFF)), document("<data>\n" + std::string(76, '/') + "\n</data>\n"));
}

TEST(XmlPropertyListWriter, WritesNumbersSoThatTheyReadBackExactly) {
    EXPECT_EQ(written(std::int64_t{INT64_MIN}), document("<integer>-9223372036854775808</integer>\n"));
    EXPECT_EQ(written(0.1), document("<real>0.1</real>\n"));
    EXPECT_EQ(written(1e22), document("<real>1e+22</real>\n"));
    EXPECT_EQ(written(-0.0), document("<real>-0</real>\n"));
    EXPECT_EQ(written(std::nan("")), document("<real>nan</real>\n"));
    EXPECT_EQ(written(-std::numeric_limits<double>::infinity()), document("<real>-infinity</real>\n"));
}

TEST(XmlPropertyListWriter, EscapesMarkupAndCarriageReturns) {
    EXPECT_EQ(written("a<b>&\"'\r\n\t"), document("<string>a&lt;b&gt;&amp;\"'&#13;\n\t</string>\n"));
    EXPECT_EQ(written(Dictionary::make({{"<k>", 1}})),
              document("<dict>\n\t<key>&lt;k&gt;</key>\n\t<integer>1</integer>\n</dict>\n"));
}

TEST(XmlPropertyListWriter, ReplacesWhatXmlCannotCarry) {
    const auto text = [](std::string_view t) { return document("<string>" + std::string(t) + "</string>\n"); };
    EXPECT_EQ(written("\0\x01\x1F\x7F"s), text("\xEF\xBF\xBD\xEF\xBF\xBD\xEF\xBF\xBD\x7F"));
    EXPECT_EQ(written("\xEF\xBF\xBE\xEF\xBF\xBF"), text("\xEF\xBF\xBD\xEF\xBF\xBD"));                  // U+FFFE, U+FFFF
    EXPECT_EQ(written("\xED\xA0\x80"), text("\xEF\xBF\xBD\xEF\xBF\xBD\xEF\xBF\xBD"));                  // a surrogate
    EXPECT_EQ(written("\xC0\x80"), text("\xEF\xBF\xBD\xEF\xBF\xBD"));                                  // overlong
    EXPECT_EQ(written("\xF4\x90\x80\x80"), text("\xEF\xBF\xBD\xEF\xBF\xBD\xEF\xBF\xBD\xEF\xBF\xBD"));  // past U+10FFFF
    EXPECT_EQ(written("a\xE2\x82"), text("a\xEF\xBF\xBD\xEF\xBF\xBD"));                                // cut
    EXPECT_EQ(written("\xC3\xA9\xE2\x82\xAC\xF0\x9F\x98\x80"), text("\xC3\xA9\xE2\x82\xAC\xF0\x9F\x98\x80"));
}

TEST(XmlPropertyListWriter, WritesDatesDownToTheSecond) {
    EXPECT_EQ(written(Date(milliseconds(1999))), document("<date>1970-01-01T00:00:01Z</date>\n"));
    EXPECT_EQ(written(Date(milliseconds(-1))), document("<date>1969-12-31T23:59:59Z</date>\n"));
    EXPECT_EQ(written(Date(sys_days(0y / 1 / 1))), document("<date>0000-01-01T00:00:00Z</date>\n"));
    EXPECT_EQ(written(Date(sys_days(10000y / 1 / 1) - 1ms)), document("<date>9999-12-31T23:59:59Z</date>\n"));
}

TEST(XmlPropertyListWriter, RefusesDatesThatCannotBeSpelled) {
    const std::string refused = "(refused) a date outside the years 0 to 9999 cannot be written";
    EXPECT_EQ(written(Date(sys_days(10000y / 1 / 1))), refused);
    EXPECT_EQ(written(Date(sys_days(0y / 1 / 1) - 1ms)), refused);
    EXPECT_EQ(written(Array::make({Date::max()})), refused);
    EXPECT_EQ(written(Date::min()), refused);
}

TEST(XmlPropertyListWriter, RefusesANoneValueAnywhere) {
    const std::string refused = "(refused) a none value cannot be written";
    EXPECT_EQ(written(Value()), refused);
    EXPECT_EQ(written(Array::make({1, Value()})), refused);
    EXPECT_EQ(written(Dictionary::make({{"a", Array::make({Value()})}})), refused);
}

TEST(XmlPropertyListWriter, RefusesWhatReadersFindTooDeep) {
    const std::string deepest = written(nestedArrays(512));
    const Result<Value> again = read(deepest);
    ASSERT_TRUE(again) << again.error().reason;
    EXPECT_EQ(*again, nestedArrays(512));
    EXPECT_EQ(written(nestedArrays(513)), "(refused) nested deeper than 512 levels");
    EXPECT_EQ(written(nestedArrays(100000 / 100)), "(refused) nested deeper than 512 levels");
}

TEST(XmlPropertyListWriter, RefusesATreeThatContainsItself) {
    const ArrayRef array = Array::make();
    array->append(array);
    EXPECT_EQ(written(array), "(refused) nested deeper than 512 levels");
    array->clear();
}

TEST(XmlPropertyListWriter, WhatIsWrittenReadsBackTheSame) {
    std::string every;
    for (int c = 1; c < 128; ++c) {
        if (c >= ' ' || c == '\t' || c == '\n' || c == '\r') every.push_back(static_cast<char>(c));
    }
    Bytes bytes;
    for (int i = 0; i < 1000; ++i) bytes.push_back(static_cast<std::uint8_t>(i));
    const Value tree = Dictionary::make({{"every character", every},
                                         {every, " "},
                                         {"ends with a carriage return", "\r\n\r"},
                                         {"]]>", "<![CDATA[ &amp; ]]>"},
                                         {"bytes", bytes},
                                         {"one", Bytes{1}},
                                         {"two", Bytes{1, 2}},
                                         {"smallest", std::numeric_limits<double>::denorm_min()},
                                         {"largest", std::numeric_limits<double>::max()},
                                         {"third", 1.0 / 3},
                                         {"infinite", std::numeric_limits<double>::infinity()},
                                         {"whole real", 3.0},
                                         {"least", std::int64_t{INT64_MIN}},
                                         {"tree", documentValue()}});
    const Result<Value> again = read(written(tree));
    ASSERT_TRUE(again) << again.error().reason;
    EXPECT_EQ(*again, tree);
}

}  // namespace
}  // namespace kelvo
