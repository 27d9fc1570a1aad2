#include <gtest/gtest.h>
#include <sys/mman.h>

#include <string>

#include "platform/encodings/PropertyList.h"

namespace kelvo {
namespace {

using namespace std::string_literals;

Result<Value> read(std::string_view text) { return readPropertyList(bytesOf(text)); }

Value value(std::string_view text) {
    Result<Value> result = read(text);
    return result ? std::move(result).value() : Value();
}

std::string reason(std::string_view text) {
    const Result<Value> result = read(text);
    return result ? "(was read)" : result.error().reason;
}

TEST(TextPropertyListReader, ReadsEveryForm) {
    EXPECT_EQ(
        value(R"(// templates were written by hand once
{
    Name = "LTE \"Info\"";  /* with quotes */
    'Band Indicator' = 13;
    Rows = ( a, "b c", (), { x = y; }, );
    Raw = <0fbd77 1C2735ae>;
}
)"),
        Value(Dictionary::make({{"Name", "LTE \"Info\""},
                                {"Band Indicator", "13"},
                                {"Rows", Array::make({"a", "b c", Array::make(), Dictionary::make({{"x", "y"}})})},
                                {"Raw", Bytes{0x0F, 0xBD, 0x77, 0x1C, 0x27, 0x35, 0xAE}}})));
}

TEST(TextPropertyListReader, ReadsABareStringAsTheWholeDocument) {
    EXPECT_EQ(value("GetTechnology"), Value("GetTechnology"));
    EXPECT_EQ(value(" \"Get Technology\"\n"), Value("Get Technology"));
    EXPECT_EQ(value("com.example.App_1/$a:b-c"), Value("com.example.App_1/$a:b-c"));
    EXPECT_EQ(value("/usr/share//doc"), Value("/usr/share//doc"));  // inside a word no comment begins
    EXPECT_EQ(value("\"\""), Value(""));
}

TEST(TextPropertyListReader, TellsDataFromXml) {
    EXPECT_EQ(value("<>"), Value(Bytes{}));
    EXPECT_EQ(value("<dada>"), Value(Bytes{0xDA, 0xDA}));
    EXPECT_EQ(value(" < 0 1\n2 3 >"), Value(Bytes{0x01, 0x23}));
    EXPECT_EQ(value("<data>dada</data>"), Value(Bytes{0x75, 0xA7, 0x5A}));
    EXPECT_EQ(reason("<dad>"), "data that ends with half a byte at offset 4");
    EXPECT_EQ(reason("(<xy>)"), "data with something else than hexadecimal digits at offset 2");
    EXPECT_EQ(reason("<dad").substr(0, 19), "data without its > ");
}

TEST(TextPropertyListReader, ReadsEntriesAtTheTopLevel) {
    EXPECT_EQ(value("/* screen */ \"Cell Info\" = \"Zelle\";\nb = (1);"),
              Value(Dictionary::make({{"Cell Info", "Zelle"}, {"b", Array::make({"1"})}})));
    EXPECT_EQ(reason("a = b"), "missing ; at offset 5");
    EXPECT_EQ(reason("a = b; c"), "missing = at offset 8");
    EXPECT_EQ(reason("a = b; }"), "unexpected character at offset 7");
}

TEST(TextPropertyListReader, LastOfTwoEqualKeysWins) {
    EXPECT_EQ(value("{ a = 1; a = 2; }"), Value(Dictionary::make({{"a", "2"}})));
}

TEST(TextPropertyListReader, ResolvesEscapes) {
    EXPECT_EQ(value(R"("\a\b\f\n\r\t\v\"\'\\")"), Value("\a\b\f\n\r\t\v\"'\\"));
    EXPECT_EQ(value(R"("\U0041\U00e9z\U20AC")"), Value("A\xC3\xA9z\xE2\x82\xAC"));
    EXPECT_EQ(value(R"("\Ud83d\Ude00")"), Value("\xF0\x9F\x98\x80"));
    EXPECT_EQ(value(R"("\Ud83d\U0041\Ude00\Ud83dz")"), Value("\xEF\xBF\xBD"
                                                             "A\xEF\xBF\xBD\xEF\xBF\xBDz"));
    EXPECT_EQ(value(R"("\101\351\1012")"), Value("A\xC3\xA9"
                                                 "A2"));
    EXPECT_EQ(value("\"\\\xC3\xA9\\q\\\n\""), Value("\xC3\xA9q\n"));
    EXPECT_EQ(value("'it is \"it\"'"), Value("it is \"it\""));
    EXPECT_EQ(value("\"\\000\\U0\""), Value("\0\0"s));
    EXPECT_EQ(reason(R"("\Uxyz")"), "\\U without a character's number at offset 2");
    EXPECT_EQ(reason(R"("\777")"), "octal escape beyond 377 at offset 2");
}

TEST(TextPropertyListReader, ReplacesBytesThatAreNotUtf8) { EXPECT_EQ(value("\"a\xFFz\""), Value("a\xEF\xBF\xBDz")); }

TEST(TextPropertyListReader, ReadsUtf16) {
    EXPECT_EQ(value("\xFF\xFE\"\0\xE9\0\"\0"s), Value("\xC3\xA9"));
    EXPECT_EQ(value("\xFE\xFF\0\"\0\xE9\0\""s), Value("\xC3\xA9"));
}

TEST(TextPropertyListReader, NamesWhatIsWrongAndWhere) {
    EXPECT_EQ(reason("{ a = b }"), "missing ; at offset 8");
    EXPECT_EQ(reason("{ a b; }"), "missing = at offset 4");
    EXPECT_EQ(reason("{ a = ; }"), "unexpected character at offset 6");
    EXPECT_EQ(reason("{ (a) = b; }"), "unexpected character at offset 2");
    EXPECT_EQ(reason("{ a = b; "), "dictionary without its } at offset 1");
    EXPECT_EQ(reason("{ a = "), "document cut short at offset 6");
    EXPECT_EQ(reason("( a b )"), "missing , at offset 4");
    EXPECT_EQ(reason("( , )"), "unexpected character at offset 2");
    EXPECT_EQ(reason("( a,"), "array without its ) at offset 1");
    EXPECT_EQ(reason("\"abc"), "string without its closing quote at offset 0");
    EXPECT_EQ(reason("\"abc\\"), "string without its closing quote at offset 0");
    EXPECT_EQ(reason("\"abc\\\""), "string without its closing quote at offset 0");
    EXPECT_EQ(reason("{ /* }"), "comment without its end at offset 2");
    EXPECT_EQ(reason("/* only */ // comments"), "document cut short at offset 22");
    EXPECT_EQ(reason("a b"), "something behind the end of the value at offset 2");
    EXPECT_EQ(reason("{} {}"), "something behind the end of the value at offset 3");
    EXPECT_EQ(reason("() = 1;"), "something behind the end of the value at offset 3");
}

TEST(TextPropertyListReader, RefusesGarbage) {
    EXPECT_EQ(reason("caf\xC3\xA9"), "something behind the end of the value at offset 3");
    EXPECT_EQ(reason("\x8F\x12zz"), "unexpected character at offset 0");
    EXPECT_EQ(reason("Hello, world"), "something behind the end of the value at offset 5");
    EXPECT_EQ(reason("abc\0"s), "not a property list: NUL at offset 3");
    EXPECT_EQ(reason("\"a\0b\""s), "not a property list: NUL at offset 2");
    EXPECT_EQ(reason("}"), "unexpected character at offset 0");
    EXPECT_EQ(reason("\xFF\xFE<\0t\0r\0"s).substr(0, 19), "not well-formed XML");
}

TEST(TextPropertyListReader, ReadsOrRefusesEveryTruncationOfADocument) {
    const std::string text = "{ a = (b, \"\\U0041\\101\", <0f>); /* c */ 'd' = { e = f; }; } // end";
    ASSERT_TRUE(read(text));
    for (std::size_t size = 0; size < text.rfind('}') + 1; ++size) EXPECT_FALSE(read(text.substr(0, size))) << size;
}

std::string repeated(std::string_view text, int count) {
    std::string all;
    for (int i = 0; i < count; ++i) all += text;
    return all;
}

TEST(TextPropertyListReader, AcceptsTheDeepestTreeAndRefusesOneLevelMore) {
    const auto nested = [](int levels) { return repeated("(", levels) + repeated(")", levels); };
    Value expected = Array::make();
    for (int i = 1; i < 512; ++i) expected = Array::make({expected});
    EXPECT_EQ(value(nested(512)), expected);
    EXPECT_EQ(reason(nested(513)), "nested deeper than 512 levels at offset 512");
    EXPECT_EQ(reason(repeated("(", 1000000)), "nested deeper than 512 levels at offset 512");
    EXPECT_EQ(reason(repeated("{a=", 1000000)), "nested deeper than 512 levels at offset 1536");
}

TEST(PropertyList, RefusesAnEmptyDocument) {
    EXPECT_EQ(reason(""), "empty document");
    EXPECT_EQ(reason(" \t\r\n"), "empty document");
    EXPECT_EQ(reason("\xEF\xBB\xBF"), "empty document");
    EXPECT_EQ(reason("\xFF\xFE"), "empty document");
    EXPECT_EQ(reason(std::string(std::size_t{16} << 20, ' ')), "empty document");
}

TEST(PropertyList, IsKnownByItsBeginning) {
    for (const char* text : {"<?xml version", "\xEF\xBB\xBF<?xml", " \r\n\t<plist ", "<!DOCTYPE plist ", "bplist00"})
        EXPECT_TRUE(beginsPropertyList(bytesOf(text))) << text;
    for (const char* text : {"", " ", "<", "<html>", "<!DOCTYPE html>", "{ a = b; }", "no list", "\xEF\xBB\xBF"})
        EXPECT_FALSE(beginsPropertyList(bytesOf(text))) << text;
}

TEST(PropertyList, RefusesADocumentOfMoreThanAGibibyteUnread) {
    const std::size_t size = (std::size_t{1} << 30) + 1;
    void* unreadable = mmap(nullptr, size, PROT_NONE, MAP_PRIVATE | MAP_ANONYMOUS | MAP_NORESERVE, -1, 0);
    ASSERT_NE(unreadable, MAP_FAILED);
    const Result<Value> result = readPropertyList({static_cast<const std::uint8_t*>(unreadable), size});
    ASSERT_FALSE(result);
    EXPECT_EQ(result.error().reason, "larger than 1073741824 bytes");
    munmap(unreadable, size);
}

}  // namespace
}  // namespace kelvo
