#include "platform/encodings/PropertyList.h"

#include <fmt/format.h>

#include <algorithm>
#include <bit>
#include <string>

#include "platform/encodings/BinaryPropertyListReader.h"
#include "platform/encodings/TextPropertyListReader.h"
#include "platform/encodings/Utf8.h"
#include "platform/encodings/XmlPropertyListReader.h"

namespace kelvo {

namespace {

constexpr std::string_view kSpace = " \t\n\v\f\r";
constexpr std::string_view kHexAndSpace = "0123456789abcdefABCDEF \t\n\v\f\r";

/// A text in angle brackets is data of the old text form when it holds hexadecimal digits only; no element of an XML
/// property list is spelled with those alone.
bool isXml(std::string_view text) {
    if (text.front() != '<') return false;
    const std::size_t end = text.find_first_not_of(kHexAndSpace, 1);
    return end != std::string_view::npos && text[end] != '>';
}

Result<Value> readText(std::string_view text) {
    const std::size_t start = text.find_first_not_of(kSpace);
    if (start == std::string_view::npos) return Failure{"empty document"};
    if (const std::size_t nul = text.find('\0'); nul != std::string_view::npos) {
        return Failure{fmt::format("not a property list: NUL at offset {}", nul)};
    }
    return isXml(text.substr(start)) ? readXmlPropertyList(text) : readTextPropertyList(text);
}

/// UTF-16 announces itself by its byte-order mark, and without one by the NUL beside XML's first character.
std::optional<std::endian> utf16Order(std::string_view text) {
    using namespace std::string_view_literals;
    if (text.starts_with("\xFF\xFE"sv) || text.starts_with("<\0"sv)) return std::endian::little;
    if (text.starts_with("\xFE\xFF"sv) || text.starts_with("\0<"sv)) return std::endian::big;
    return std::nullopt;
}

std::string_view withoutByteOrderMark(std::string_view text) {
    constexpr std::string_view kMark = "\xEF\xBB\xBF";
    return text.starts_with(kMark) ? text.substr(kMark.size()) : text;
}

}  // namespace

bool beginsPropertyList(ByteView beginning) {
    if (isBinaryPropertyList(textOf(beginning))) return true;
    std::string_view text = withoutByteOrderMark(textOf(beginning));
    text.remove_prefix(std::min(text.find_first_not_of(kSpace), text.size()));
    return text.starts_with("<?xml") || text.starts_with("<plist") || text.starts_with("<!DOCTYPE plist");
}

Result<Value> readPropertyList(ByteView data) {
    if (data.size() > kMaxPropertyListSize) return Failure{fmt::format("larger than {} bytes", kMaxPropertyListSize)};
    const std::string_view text = textOf(data);
    if (isBinaryPropertyList(text)) return readBinaryPropertyList(data);
    if (const auto order = utf16Order(text)) return readText(withoutByteOrderMark(utf8FromUtf16(data, *order)));
    return readText(withoutByteOrderMark(text));
}

}  // namespace kelvo
