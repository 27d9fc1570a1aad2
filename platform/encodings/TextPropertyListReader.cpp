#include "platform/encodings/TextPropertyListReader.h"

#include <fmt/format.h>

#include <algorithm>
#include <optional>
#include <string>
#include <vector>

#include "platform/encodings/PropertyList.h"
#include "platform/encodings/Utf8.h"

namespace kelvo {

namespace {

bool isSpace(char c) { return c == ' ' || (c >= '\t' && c <= '\r'); }

bool isWordCharacter(char c) {
    return (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z') || (c >= '0' && c <= '9') ||
           std::string_view("_$/:.-").find(c) != std::string_view::npos;
}

std::optional<unsigned> digit(char c, unsigned base) {
    unsigned value = 36;
    if (c >= '0' && c <= '9') value = static_cast<unsigned>(c - '0');
    if (c >= 'a' && c <= 'f') value = static_cast<unsigned>(c - 'a') + 10;
    if (c >= 'A' && c <= 'F') value = static_cast<unsigned>(c - 'A') + 10;
    return value < base ? std::optional(value) : std::nullopt;
}

class TextReader {
public:
    explicit TextReader(std::string_view text) : _text(text) {}

    Result<Value> read() {
        Value value;
        if (!readDocument(value)) return Failure{std::move(_reason)};
        return value;
    }

private:
    bool readDocument(Value& out) {
        if (!readValue(1, out) || !skipSpace()) return false;
        if (out.string() != nullptr && peek() == '=') {
            _at = 0;
            if (!readEntries(1, '\0', out)) return false;
        }
        return _at == _text.size() || fail("something behind the end of the value", _at);
    }

    bool readValue(int depth, Value& out) {
        if (depth > kMaxPropertyListDepth) {
            return fail(fmt::format("nested deeper than {} levels", kMaxPropertyListDepth), _at);
        }
        if (!skipSpace()) return false;
        switch (peek()) {
            case '{': ++_at; return readEntries(depth, '}', out);
            case '(': ++_at; return readArray(depth, out);
            case '<': ++_at; return readData(out);
            default: return readString(out.text());
        }
    }

    /// Entries up to `end`, which is '\0' for the end of the document.
    bool readEntries(int depth, char end, Value& out) {
        auto dictionary = std::make_shared<Dictionary>();
        const std::size_t start = _at;
        std::string key;
        while (true) {
            if (!skipSpace()) return false;
            if (peek() == end) break;
            if (_at == _text.size()) return fail("dictionary without its }", start);
            if (!readString(key) || !expect('=')) return false;
            if (!readValue(depth + 1, dictionary->slot(key)) || !expect(';')) return false;
        }
        if (end != '\0') ++_at;
        out = std::move(dictionary);
        return true;
    }

    bool readArray(int depth, Value& out) {
        std::vector<Value> elements;
        const std::size_t start = _at;
        while (true) {
            if (!skipSpace()) return false;
            if (peek() == ')') break;
            if (_at == _text.size()) return fail("array without its )", start);
            if (!readValue(depth + 1, elements.emplace_back()) || !skipSpace()) return false;
            if (peek() != ')' && !expect(',')) return false;
        }
        ++_at;
        out = std::make_shared<Array>(std::move(elements));
        return true;
    }

    bool readData(Value& out) {
        Bytes bytes;
        const std::size_t start = _at;
        std::optional<unsigned> high;
        for (; peek() != '>'; ++_at) {
            if (_at == _text.size()) return fail("data without its >", start);
            if (isSpace(peek())) continue;
            const auto half = digit(peek(), 16);
            if (!half) return fail("data with something else than hexadecimal digits", _at);
            if (high) bytes.push_back(static_cast<std::uint8_t>(*high << 4U | *half));
            high = high ? std::nullopt : half;
        }
        if (high) return fail("data that ends with half a byte", _at);
        ++_at;
        out = std::move(bytes);
        return true;
    }

    bool readString(std::string& out) {
        out.clear();
        if (peek() == '"' || peek() == '\'') return readQuoted(out);
        const std::size_t start = _at;
        while (isWordCharacter(peek())) ++_at;
        out = _text.substr(start, _at - start);
        return _at > start || fail(_at < _text.size() ? "unexpected character" : "document cut short", _at);
    }

    bool readQuoted(std::string& out) {
        const std::size_t start = _at;
        const char quote = _text[_at++];
        const char stops[] = {quote, '\\'};
        while (true) {
            const std::size_t stop = _text.find_first_of({stops, 2}, _at);
            if (stop == std::string_view::npos) return fail("string without its closing quote", start);
            appendCleanUtf8(out, _text.substr(_at, stop - _at));
            _at = stop + 1;
            if (_text[stop] == quote) return true;
            if (!readEscape(out)) return false;
        }
    }

    /// What follows a backslash.
    bool readEscape(std::string& out) {
        const char c = peek();
        const std::string_view kNames = "abfnrtv";
        const std::string_view kCodes = "\a\b\f\n\r\t\v";
        if (const std::size_t name = kNames.find(c); name != std::string_view::npos) {
            out.push_back(kCodes[name]);
            ++_at;
            return true;
        }
        if (c == 'U') return readUnicodeEscape(out);
        if (digit(c, 8)) return readOctalEscape(out);
        if (c == '"' || c == '\'' || c == '\\') {
            out.push_back(c);
            ++_at;
        }
        return true;  // any other character stands for itself, and is read with what follows it
    }

    std::optional<char32_t> readDigits(unsigned base, std::size_t most) {
        const std::size_t start = _at;
        char32_t code = 0;
        for (auto next = digit(peek(), base); next && _at < start + most; next = digit(peek(), base)) {
            code = code * base + *next;
            ++_at;
        }
        return _at > start ? std::optional(code) : std::nullopt;
    }

    bool readOctalEscape(std::string& out) {
        const std::size_t start = _at;
        const auto code = readDigits(8, 3);
        if (!code || *code > 0xFF) return fail("octal escape beyond 377", start);
        appendUtf8(out, *code);
        return true;
    }

    /// \U and up to four hexadecimal digits: a unit of UTF-16, so that two of them may make up one character.
    bool readUnicodeEscape(std::string& out) {
        const std::size_t start = _at++;
        auto code = readDigits(16, 4);
        if (!code) return fail("\\U without a character's number", start);
        if (*code >= 0xD800 && *code < 0xDC00 && _text.substr(_at, 2) == "\\U") {
            const std::size_t second = _at;
            _at += 2;
            const char32_t low = readDigits(16, 4).value_or(0);
            if (low >= 0xDC00 && low < 0xE000) {
                *code = 0x10000 + ((*code - 0xD800) << 10) + (low - 0xDC00);
            } else {
                _at = second;
            }
        }
        appendUtf8(out, *code);
        return true;
    }

    /// Skips white space and comments; false, with the reason, when a comment does not end.
    bool skipSpace() {
        while (true) {
            while (isSpace(peek())) ++_at;
            const std::string_view rest = _text.substr(_at, 2);
            if (rest == "//") {
                _at = std::min(_text.find_first_of("\r\n", _at), _text.size());
            } else if (rest == "/*") {
                const std::size_t end = _text.find("*/", _at + 2);
                if (end == std::string_view::npos) return fail("comment without its end", _at);
                _at = end + 2;
            } else {
                return true;
            }
        }
    }

    bool expect(char c) {
        if (!skipSpace()) return false;
        if (peek() != c) return fail(fmt::format("missing {}", c), _at);
        ++_at;
        return true;
    }

    /// The character at hand; NUL, which stands nowhere in the text, at its end.
    char peek() const { return _at < _text.size() ? _text[_at] : '\0'; }

    bool fail(std::string_view what, std::size_t at) {
        _reason = fmt::format("{} at offset {}", what, at);
        return false;
    }

    std::string_view _text;
    std::size_t _at = 0;
    std::string _reason;
};

}  // namespace

Result<Value> readTextPropertyList(std::string_view text) { return TextReader(text).read(); }

}  // namespace kelvo
