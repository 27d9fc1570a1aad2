#include "tools/share/Pseudonyms.h"

#include <sodium.h>

#include <algorithm>
#include <bit>
#include <stdexcept>

namespace kelvo {

namespace {

constexpr std::size_t kMostKnown = 1 << 16;
constexpr int kRounds = 10;

// clang-format off
// From 2^31 on numbers are shown as negative ones too, and keep the digits of those.
constexpr auto kBounds = std::to_array<std::uint64_t>({
    0, 1, 10, 100, 255, 256, 1'000, 10'000, 65'535, 65'536, 100'000, 1'000'000, 10'000'000, 100'000'000,
    268'435'455, 268'435'456, 1'000'000'000, 2'147'483'647, 2'147'483'648, 3'294'967'297, 4'194'967'297,
    4'284'967'297, 4'293'967'297, 4'294'867'297, 4'294'957'297, 4'294'966'297, 4'294'967'197, 4'294'967'287,
    4'294'967'295, 4'294'967'296,
});
// clang-format on

void startSodium() {
    static const int kStarted = sodium_init();
    if (kStarted < 0) throw std::runtime_error("libsodium cannot start");
}

void append(Bytes& to, std::uint64_t number) {
    for (int i = 0; i < 8; ++i) to.push_back(static_cast<std::uint8_t>(number >> 8 * i));
}

ByteView viewOf(std::string_view text) { return {reinterpret_cast<const std::uint8_t*>(text.data()), text.size()}; }

bool areAll(std::string_view text, char c) { return text.find_first_not_of(c) == std::string_view::npos; }

}  // namespace

Pseudonyms::Secret Pseudonyms::randomSecret() {
    startSodium();
    Secret secret{};
    randombytes_buf(secret.data(), secret.size());
    return secret;
}

Pseudonyms::Secret Pseudonyms::secretOf(std::string_view words) {
    startSodium();
    Secret secret{};
    crypto_generichash(secret.data(), secret.size(), viewOf(words).data(), words.size(), nullptr, 0);
    return secret;
}

std::uint64_t Pseudonyms::hash(std::string_view purpose, ByteView content, std::uint64_t number) const {
    Bytes bytes(purpose.begin(), purpose.end());
    bytes.push_back(0);
    append(bytes, number);
    bytes.insert(bytes.end(), content.begin(), content.end());
    std::array<std::uint8_t, 16> result{};
    crypto_generichash(result.data(), result.size(), bytes.data(), bytes.size(), _secret.data(), _secret.size());
    std::uint64_t word = 0;
    for (int i = 0; i < 8; ++i) word = word << 8 | result[static_cast<std::size_t>(i)];
    return word;
}

/// A permutation of the numbers below `count`, or its inverse: a Feistel network over the next even number of bits,
/// gone through again for as long as what comes out lies beyond.
std::uint64_t Pseudonyms::scrambled(std::string_view purpose, std::uint64_t value, std::uint64_t count,
                                    bool back) const {
    const int half = std::max(1, (static_cast<int>(std::bit_width(count - 1)) + 1) / 2);
    const std::uint64_t mask = (std::uint64_t{1} << half) - 1;
    Bytes round(16);
    const auto mixed = [&](int number, std::uint64_t word) {
        round.clear();
        append(round, count);
        append(round, word);
        return hash(purpose, round, static_cast<std::uint64_t>(number) + 1) & mask;
    };
    do {
        std::uint64_t left = value >> half;
        std::uint64_t right = value & mask;
        for (int i = 0; i < kRounds; ++i) {
            if (back) {
                const std::uint64_t before = right ^ mixed(kRounds - 1 - i, left);
                right = left;
                left = before;
            } else {
                const std::uint64_t next = left ^ mixed(i, right);
                left = right;
                right = next;
            }
        }
        value = left << half | right;
    } while (value >= count);
    return value;
}

// Around a circle in a secret order, a secret number of places on: nobody stays where he is.
std::uint64_t Pseudonyms::permuted(std::string_view purpose, std::uint64_t value, std::uint64_t low,
                                   std::uint64_t end) {
    const std::uint64_t count = end - low;
    if (count < 2 || value < low || value >= end) return value;
    Bytes key(purpose.begin(), purpose.end());
    key.push_back(0);
    append(key, low);
    append(key, end);
    const std::uint64_t places = 1 + hash("places", key) % (count - 1);
    append(key, value);
    if (_known.size() >= kMostKnown) _known.clear();
    const auto [known, isNew] = _known.try_emplace(std::string(key.begin(), key.end()));
    if (isNew) {
        const std::uint64_t at = scrambled(purpose, value - low, count, false);
        const std::uint64_t next = at >= count - places ? at - (count - places) : at + places;
        known->second = low + scrambled(purpose, next, count, true);
    }
    return known->second;
}

std::uint32_t Pseudonyms::number(std::string_view purpose, std::uint32_t value, std::span<const std::uint64_t> bounds) {
    const auto above = std::ranges::upper_bound(kBounds, std::uint64_t{value});
    std::uint64_t low = *(above - 1);
    std::uint64_t end = *above;
    for (const std::uint64_t bound : bounds) {
        if (bound <= value) low = std::max(low, bound);
        if (bound > value) end = std::min(end, bound);
    }
    return static_cast<std::uint32_t>(permuted(purpose, value, low, end));
}

std::string Pseudonyms::digits(std::string_view purpose, std::string_view digits) {
    constexpr std::size_t kPiece = 18;  // as many fit 64 bits
    if (areAll(digits, '0')) return std::string(digits);
    std::string result(digits);
    const auto replace = [&](std::size_t at, std::size_t size, std::string_view others) {
        std::uint64_t value = 0;
        std::uint64_t end = 1;
        for (const char c : std::string_view(result).substr(at, size)) {
            value = value * 10 + static_cast<std::uint64_t>(c - '0');
            end *= 10;
        }
        value = permuted(std::string(purpose) + ':' + std::string(others), value, 0, end);
        for (std::size_t i = at + size; i > at; --i, value /= 10) result[i - 1] = static_cast<char>('0' + value % 10);
    };
    if (digits.size() <= kPiece) {
        replace(0, digits.size(), {});
        return result;
    }
    // Each piece depends on all the others: first on what they were, the last one on what they have become.
    for (std::size_t at = 0; at < digits.size(); at += kPiece) {
        const std::size_t size = std::min(kPiece, digits.size() - at);
        const std::string others = result.substr(0, at) + '|' + result.substr(at + size);
        replace(at, size, others);
    }
    return result;
}

Bytes Pseudonyms::octets(std::string_view purpose, ByteView octets) {
    const auto are = [&](std::uint8_t what) {
        return std::ranges::all_of(octets, [=](std::uint8_t octet) { return octet == what; });
    };
    Bytes result(octets.begin(), octets.end());
    if (are(0) || are(0xFF)) return result;
    if (octets.size() > 7) {
        for (std::size_t i = 0; i < result.size(); ++i) {
            result[i] = static_cast<std::uint8_t>(hash(purpose, octets, i));
        }
        return result;
    }
    std::uint64_t value = 0;
    for (const std::uint8_t octet : octets) value = value << 8 | octet;
    value = permuted(purpose, value, 1, (std::uint64_t{1} << 8 * octets.size()) - 1);
    for (std::size_t i = result.size(); i > 0; --i, value >>= 8) result[i - 1] = static_cast<std::uint8_t>(value);
    return result;
}

std::string Pseudonyms::letters(std::string_view purpose, std::string_view text) const {
    std::string result(text);
    for (std::size_t i = 0; i < text.size(); ++i) {
        const std::uint64_t word = hash(purpose, viewOf(text), i);
        const auto other = [&](char first, unsigned count) {  // any but itself
            const auto own = static_cast<unsigned>(text[i] - first);
            return static_cast<char>(first + static_cast<int>((own + 1 + word % (count - 1)) % count));
        };
        if (text[i] >= '0' && text[i] <= '9') result[i] = other('0', 10);
        if (text[i] >= 'a' && text[i] <= 'z') result[i] = other('a', 26);
        if (text[i] >= 'A' && text[i] <= 'Z') result[i] = other('A', 26);
        if (static_cast<unsigned char>(text[i]) >= 0x80) result[i] = '?';
    }
    return result;
}

}  // namespace kelvo
