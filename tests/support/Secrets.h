#pragma once

#include <algorithm>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "platform/values/Bytes.h"

namespace kelvo::test {

/// One secret that is planted in a file, and all the ways in which it could still stand there.
class Secret {
public:
    /// A number of a card, a subscriber, a telephone: as text, in nibbles of either order.
    static Secret digits(const std::string& name, const std::string& digits) {
        Secret secret(name);
        secret.addText(digits);
        const std::string even = digits.size() % 2 == 0 ? digits : digits + "F";
        secret.addBytes(nibbles(even, false));
        secret.addBytes(nibbles(even, true));
        return secret;
    }
    /// A number of `width` bytes: as decimal and hexadecimal text, the low byte or the high byte first.
    static Secret number(const std::string& name, std::uint64_t number, int width) {
        Secret secret(name);
        secret.addText(std::to_string(number));
        Bytes bytes;
        for (int i = 0; i < width; ++i) bytes.push_back(static_cast<std::uint8_t>(number >> 8 * i));
        secret.addBytes(bytes);
        std::reverse(bytes.begin(), bytes.end());
        secret.addBytes(bytes);
        return secret;
    }
    static Secret bytes(const std::string& name, Bytes bytes) {
        Secret secret(name);
        secret.addBytes(bytes);
        std::reverse(bytes.begin(), bytes.end());
        secret.addBytes(bytes);
        return secret;
    }
    /// Four bytes of an address, with dots as well.
    static Secret address(const std::string& name, const Bytes& bytes) {
        Secret secret = Secret::bytes(name, bytes);
        std::string dotted;
        for (const std::uint8_t byte : bytes) dotted += (dotted.empty() ? "" : ".") + std::to_string(byte);
        secret.addText(dotted);
        return secret;
    }
    static Secret text(const std::string& name, const std::string& text) {
        Secret secret(name);
        secret.addText(text);
        return secret;
    }

    const std::string& name() const { return _name; }
    /// In which way it stands in `content`; empty when it does not.
    std::string foundIn(std::string_view content) const {
        for (const auto& [way, pattern] : _patterns) {
            if (content.find(pattern) != content.npos) return way;
        }
        return {};
    }

private:
    explicit Secret(std::string name) : _name(std::move(name)) {}

    void add(const std::string& way, std::string pattern) { _patterns.emplace_back(way, std::move(pattern)); }
    void addText(const std::string& text) {
        std::string little;
        std::string big;
        for (const char c : text) {
            little += {c, '\0'};
            big += {'\0', c};
        }
        for (const auto& [way, raw] : {std::pair("text", text), {"UTF-16LE", little}, {"UTF-16BE", big}}) {
            add(way, raw);
            addBase64(std::string(way) + " in ", raw);
        }
    }
    void addBytes(const Bytes& bytes) {
        const std::string raw(bytes.begin(), bytes.end());
        add("bytes", raw);
        addBase64("bytes in ", raw);
        for (const char* digits : {"0123456789ABCDEF", "0123456789abcdef"}) {
            std::string text;
            for (const std::uint8_t byte : bytes) text += {digits[byte >> 4], digits[byte & 15]};
            addText(text);
        }
    }
    /// What stands in Base64 for the bytes alone, wherever they begin in a group of three.
    void addBase64(const std::string& way, const std::string& raw) {
        for (std::size_t before = 0; before < 3; ++before) {
            const std::string all = std::string(before, '\0') + raw;
            std::string text;
            for (std::size_t bit = (8 * before + 5) / 6 * 6; bit + 6 <= 8 * all.size(); bit += 6) {
                unsigned value = 0;
                for (std::size_t i = bit; i < bit + 6; ++i) {
                    value = value << 1 | (static_cast<unsigned char>(all[i / 8]) >> (7 - i % 8) & 1U);
                }
                text += "ABCDEFGHIJKLMNOPQRSTUVWXYZabcdefghijklmnopqrstuvwxyz0123456789+/"[value];
            }
            if (text.size() >= 3) add(way + "Base64", text);
        }
    }
    static Bytes nibbles(const std::string& digits, bool swapped) {
        const auto value = [](char c) { return static_cast<std::uint8_t>(c == 'F' ? 15 : c - '0'); };
        Bytes bytes;
        for (std::size_t i = 0; i < digits.size(); i += 2) {
            const std::uint8_t first = value(digits[i]);
            const std::uint8_t second = value(digits[i + 1]);
            bytes.push_back(static_cast<std::uint8_t>(swapped ? second << 4 | first : first << 4 | second));
        }
        return bytes;
    }

    std::string _name;
    std::vector<std::pair<std::string, std::string>> _patterns;
};

}  // namespace kelvo::test
