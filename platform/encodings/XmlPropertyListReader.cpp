#include "platform/encodings/XmlPropertyListReader.h"

#include <fmt/format.h>

#include <algorithm>
#include <charconv>
#include <optional>
#include <pugixml.hpp>
#include <string>
#include <vector>

#include "platform/encodings/Base64.h"
#include "platform/encodings/IsoDate.h"
#include "platform/encodings/PropertyList.h"
#include "platform/encodings/Utf8.h"

namespace kelvo {

namespace {

// References are resolved here and not by the parser, which keeps unknown ones as text and ends a text at "&#0;".
constexpr unsigned kParseFlags = pugi::parse_cdata | pugi::parse_eol | pugi::parse_fragment;

/// How the parser treats text that is white space alone. All of it matters once a comment, an instruction or character
/// data may cut a string in pieces; a document without any reads a good deal faster when what lies between elements is
/// left out.
unsigned spaceFlag(std::string_view text) {
    const std::size_t prolog = text.starts_with("<?xml") ? text.find("?>") : std::string_view::npos;
    const std::size_t body = prolog == std::string_view::npos ? 0 : prolog + 2;
    const bool mayBeCut = text.find('!') != std::string_view::npos || text.find('?', body) != std::string_view::npos;
    return mayBeCut ? pugi::parse_ws_pcdata : pugi::parse_ws_pcdata_single;
}

bool isSpace(char c) { return c == ' ' || (c >= '\t' && c <= '\r'); }

std::string_view trimmed(std::string_view text) {
    while (!text.empty() && isSpace(text.front())) text.remove_prefix(1);
    while (!text.empty() && isSpace(text.back())) text.remove_suffix(1);
    return text;
}

/// The number that all of `text` spells; `notation` is the base of an integer, nothing for a real.
template <class T, class... Notation>
std::optional<T> number(std::string_view text, Notation... notation) {
    T value{};
    const char* end = text.data() + text.size();
    const auto [stop, error] = std::from_chars(text.data(), end, value, notation...);
    return error == std::errc() && stop == end ? std::optional(value) : std::nullopt;
}

/// Decimal, or hexadecimal behind "0x"; none outside 64 signed bits.
std::optional<std::int64_t> parseInteger(std::string_view text) {
    const bool negative = text.starts_with('-');
    if (negative || text.starts_with('+')) text.remove_prefix(1);
    const bool hexadecimal = text.starts_with("0x") || text.starts_with("0X");
    if (hexadecimal) text.remove_prefix(2);
    const auto magnitude = number<std::uint64_t>(text, hexadecimal ? 16 : 10);
    constexpr std::uint64_t kTop = std::uint64_t{1} << 63;
    if (!magnitude || *magnitude > (negative ? kTop : kTop - 1)) return std::nullopt;
    return static_cast<std::int64_t>(negative ? -*magnitude : *magnitude);
}

/// Any decimal notation, "nan", "inf" and "infinity"; none beyond the range of a double.
std::optional<double> parseReal(std::string_view text) {
    if (text.starts_with('+') && !text.starts_with("+-")) text.remove_prefix(1);
    return number<double>(text);
}

/// What stands between '&' and ';' as a character; none when it is neither one of the five nor a valid number.
std::optional<char32_t> parseReference(std::string_view name) {
    if (name == "amp") return U'&';
    if (name == "lt") return U'<';
    if (name == "gt") return U'>';
    if (name == "quot") return U'"';
    if (name == "apos") return U'\'';
    if (!name.starts_with('#')) return std::nullopt;
    name.remove_prefix(1);
    const bool hexadecimal = name.starts_with('x');
    if (hexadecimal) name.remove_prefix(1);
    const auto code = number<std::uint32_t>(name, hexadecimal ? 16 : 10);
    if (!code || *code == 0 || *code > 0x10FFFF || (*code >= 0xD800 && *code < 0xE000)) return std::nullopt;
    return *code;
}

class XmlReader {
public:
    Result<Value> read(std::string_view text) {
        const auto parsed = _document.load_buffer(text.data(), text.size(), kParseFlags | spaceFlag(text));
        if (!parsed) {
            return Failure{fmt::format("not well-formed XML at offset {}: {}", parsed.offset, parsed.description())};
        }
        Value value;
        if (!readDocument(value)) return Failure{std::move(_reason)};
        return value;
    }

private:
    bool readDocument(Value& out) {
        pugi::xml_node root;
        if (!onlyElement(_document, root)) return false;
        if (std::string_view(root.name()) != "plist") return readValue(root, 1, out);
        pugi::xml_node value;
        return onlyElement(root, value) && readValue(value, 1, out);
    }

    /// The one element in `parent`; elsewhere in it only white space may stand.
    bool onlyElement(pugi::xml_node parent, pugi::xml_node& out) {
        for (pugi::xml_node child : parent.children()) {
            if (!isElement(child)) {
                if (!isBlank(child)) return false;
                continue;
            }
            if (out) return fail("second root value", child);
            out = child;
        }
        return out || fail("no value in the document", parent);
    }

    bool readValue(pugi::xml_node node, int depth, Value& out) {
        if (depth > kMaxPropertyListDepth) {
            return fail(fmt::format("nested deeper than {} levels", kMaxPropertyListDepth), node);
        }
        const std::string_view name = node.name();
        if (name == "string") return readString(node, out);
        if (name == "integer") return readScalar(node, "integer", parseInteger, out);
        if (name == "dict") return readDictionary(node, depth, out);
        if (name == "array") return readArray(node, depth, out);
        if (name == "true" || name == "false") return readBoolean(node, name == "true", out);
        if (name == "real") return readScalar(node, "real", parseReal, out);
        if (name == "data") return readScalar(node, "data", bytesFromBase64, out);
        if (name == "date") return readScalar(node, "date", dateFromIso, out);
        return fail(fmt::format("unknown element <{}>", name.substr(0, 32)), node);
    }

    bool readDictionary(pugi::xml_node node, int depth, Value& out) {
        auto dictionary = std::make_shared<Dictionary>();
        pugi::xml_node key;  // that waits for its value
        for (pugi::xml_node child : node.children()) {
            if (!isElement(child)) {
                if (!isBlank(child)) return false;
            } else if ((std::string_view(child.name()) == "key") == static_cast<bool>(key)) {
                return key ? fail("key without a value", key) : fail("value without a key", child);
            } else if (key) {
                const auto text = textIn(key);
                if (!text || !readValue(child, depth + 1, dictionary->slot(*text))) return false;
                key = {};
            } else {
                key = child;
            }
        }
        if (key) return fail("key without a value", key);
        out = std::move(dictionary);
        return true;
    }

    bool readArray(pugi::xml_node node, int depth, Value& out) {
        std::vector<Value> elements;
        for (pugi::xml_node child : node.children()) {
            if (!isElement(child)) {
                if (!isBlank(child)) return false;
            } else if (!readValue(child, depth + 1, elements.emplace_back())) {
                return false;
            }
        }
        out = std::make_shared<Array>(std::move(elements));
        return true;
    }

    bool readString(pugi::xml_node node, Value& out) {
        const auto text = textIn(node);
        if (!text) return false;
        out = *text;
        return true;
    }

    bool readBoolean(pugi::xml_node node, bool boolean, Value& out) {
        for (pugi::xml_node child : node.children()) {
            if (isElement(child)) return fail("element inside a boolean", child);
            if (!isBlank(child)) return false;
        }
        out = boolean;
        return true;
    }

    template <class Parse>
    bool readScalar(pugi::xml_node node, std::string_view what, Parse parse, Value& out) {
        const auto text = textIn(node);
        if (!text) return false;
        auto parsed = parse(trimmed(*text));
        if (!parsed) return fail(fmt::format("<{}> that holds no valid {}", what, what), node);
        out = std::move(*parsed);
        return true;
    }

    /// The characters in `node`, which may hold nothing else; valid until the next call. Most texts are one plain run
    /// and are read where they stand.
    std::optional<std::string_view> textIn(pugi::xml_node node) {
        const pugi::xml_node first = node.first_child();
        if (!first.next_sibling() && !isElement(first)) {
            const std::string_view text = first.value();
            if (isAscii(text) && text.find('&') == std::string_view::npos) return text;
        }
        _text.clear();
        for (pugi::xml_node child : node.children()) {
            if (isElement(child)) {
                fail(fmt::format("element inside <{}>", node.name()), child);
                return std::nullopt;
            }
            if (!appendText(child)) return std::nullopt;
        }
        return _text;
    }

    bool appendText(pugi::xml_node node) {
        std::string_view text = node.value();
        while (node.type() == pugi::node_pcdata) {
            const std::size_t reference = text.find('&');
            if (reference == std::string_view::npos) break;
            appendCleanUtf8(_text, text.substr(0, reference));
            text.remove_prefix(reference + 1);
            const std::size_t end = std::min(text.find(';'), text.size());
            const auto code = parseReference(text.substr(0, end));
            if (!code || end == text.size()) return fail("unknown entity or character reference in the text", node);
            appendUtf8(_text, *code);
            text.remove_prefix(end + 1);
        }
        appendCleanUtf8(_text, text);
        return true;
    }

    static bool isElement(pugi::xml_node node) { return node.type() == pugi::node_element; }

    /// Whether a text between elements is white space; a failure when it is not.
    bool isBlank(pugi::xml_node node) {
        const std::string_view text = node.value();
        return std::all_of(text.begin(), text.end(), isSpace) || fail("text where none belongs", node);
    }

    bool fail(std::string_view what, pugi::xml_node where) {
        _reason = fmt::format("{} at offset {}", what, std::max<std::ptrdiff_t>(where.offset_debug(), 0));
        return false;
    }

    pugi::xml_document _document;
    std::string _text;  // of an element whose text does not stand in one piece
    std::string _reason;
};

}  // namespace

Result<Value> readXmlPropertyList(std::string_view text) { return XmlReader().read(text); }

}  // namespace kelvo
