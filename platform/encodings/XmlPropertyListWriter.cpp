#include <fmt/format.h>

#include <algorithm>
#include <array>
#include <charconv>
#include <cmath>
#include <string>

#include "platform/encodings/Base64.h"
#include "platform/encodings/IsoDate.h"
#include "platform/encodings/PropertyList.h"
#include "platform/encodings/Utf8.h"

namespace kelvo {

namespace {

constexpr std::size_t kDataLine = 57;  // bytes; 76 characters of Base64

/// Whether a byte of a text stands for itself in XML.
bool isPlain(char c) { return (c >= ' ' && c <= '~' && c != '&' && c != '<' && c != '>') || c == '\n' || c == '\t'; }

/// The characters of XML 1.0 (its production 2); surrogates never come out of UTF-8.
bool isXmlCharacter(char32_t code) {
    return code >= 0x20 ? code != 0xFFFE && code != 0xFFFF : code == '\t' || code == '\n' || code == '\r';
}

class XmlWriter {
public:
    Result<Bytes> write(const Value& value) {
        put("<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n<plist version=\"1.0\">\n");
        if (!writeValue(value, 1)) return Failure{std::move(_reason)};
        put("</plist>\n");
        const ByteView bytes = bytesOf(_out);
        return Bytes(bytes.begin(), bytes.end());
    }

private:
    bool writeValue(const Value& value, int depth) {
        if (depth > kMaxPropertyListDepth) {
            return fail(fmt::format("nested deeper than {} levels", kMaxPropertyListDepth));
        }
        indent(depth);
        switch (value.kind()) {
            case Value::Kind::None: return fail("a none value cannot be written");
            case Value::Kind::String: return element("string", *value.string());
            case Value::Kind::Number: return writeNumber(*value.number());
            case Value::Kind::Boolean: return put(*value.boolean() ? "<true/>\n" : "<false/>\n");
            case Value::Kind::Data: return writeData(*value.data(), depth);
            case Value::Kind::Date: return writeDate(*value.date());
            case Value::Kind::Array: return writeArray(*value.array(), depth);
            case Value::Kind::Dictionary: return writeDictionary(*value.dictionary(), depth);
        }
        return false;
    }

    bool writeNumber(const Number& number) {
        std::array<char, 32> text{};
        if (!number.isReal()) return element("integer", fmt::format_int(number.integer()).c_str());
        const double real = number.real();
        if (std::isnan(real)) return element("real", "nan");
        if (std::isinf(real)) return element("real", real > 0 ? "+infinity" : "-infinity");
        const auto end = std::to_chars(text.data(), text.data() + text.size(), real);  // the shortest that reads back
        return element("real", {text.data(), end.ptr});
    }

    bool writeDate(Date date) {
        if (!hasIsoForm(date)) return fail("a date outside the years 0 to 9999 cannot be written");
        return element("date", isoDate(date));
    }

    bool writeData(ByteView data, int depth) {
        if (data.empty()) return put("<data></data>\n");
        put("<data>\n");
        for (std::size_t at = 0; at < data.size(); at += kDataLine) {
            indent(depth);
            appendBase64(_out, data.subspan(at, std::min(kDataLine, data.size() - at)));
            put("\n");
        }
        indent(depth);
        return put("</data>\n");
    }

    bool writeArray(const Array& array, int depth) {
        if (array.empty()) return put("<array/>\n");
        put("<array>\n");
        for (const Value& element : array) {
            if (!writeValue(element, depth + 1)) return false;
        }
        indent(depth);
        return put("</array>\n");
    }

    bool writeDictionary(const Dictionary& dictionary, int depth) {
        if (dictionary.empty()) return put("<dict/>\n");
        put("<dict>\n");
        for (const auto& [key, value] : dictionary) {
            indent(depth + 1);
            element("key", key);
            if (!writeValue(value, depth + 1)) return false;
        }
        indent(depth);
        return put("</dict>\n");
    }

    bool element(std::string_view name, std::string_view text) {
        put("<");
        put(name);
        put(">");
        putEscaped(text);
        put("</");
        put(name);
        return put(">\n");
    }

    void putEscaped(std::string_view text) {
        while (true) {
            const auto run =
                static_cast<std::size_t>(std::find_if_not(text.begin(), text.end(), isPlain) - text.begin());
            put(text.substr(0, run));
            text.remove_prefix(run);
            if (text.empty()) return;
            const Utf8Character character = firstUtf8Character(text);
            putCharacter(character.code);
            text.remove_prefix(character.length);
        }
    }

    void putCharacter(char32_t code) {
        if (code == '&') return void(put("&amp;"));
        if (code == '<') return void(put("&lt;"));
        if (code == '>') return void(put("&gt;"));
        if (code == '\r') return void(put("&#13;"));  // as itself it would be read as a newline
        appendUtf8(_out, isXmlCharacter(code) ? code : kReplacementCharacter);
    }

    /// The root stands at the margin.
    void indent(int depth) { _out.append(static_cast<std::size_t>(depth - 1), '\t'); }

    bool put(std::string_view text) {
        _out.append(text);
        return true;
    }

    bool fail(std::string reason) {
        _reason = std::move(reason);
        return false;
    }

    std::string _out;
    std::string _reason;
};

}  // namespace

Result<Bytes> writeXmlPropertyList(const Value& value) { return XmlWriter().write(value); }

}  // namespace kelvo
