#pragma once

#include <array>
#include <cstdint>
#include <span>
#include <string>
#include <string_view>
#include <unordered_map>

#include "platform/values/Bytes.h"

namespace kelvo {

/// Pseudonyms under a secret: the same identity has the same one, two identities have two, none has itself, and without
/// the secret nobody can tell which is whose. They keep the form: a number stays in its range, with as many digits.
///
/// The hash is libsodium's keyed BLAKE2b. One thread at a time; memory is bounded.
class Pseudonyms {
public:
    using Secret = std::array<std::uint8_t, 32>;
    /// Another one every time.
    static Secret randomSecret();
    /// The same for the same words.
    static Secret secretOf(std::string_view words);

    explicit Pseudonyms(const Secret& secret) : _secret(secret) {}

    /// 64 bits that depend on the purpose, the content and a number.
    std::uint64_t hash(std::string_view purpose, ByteView content, std::uint64_t number = 0) const;

    /// A number from `low` on and below `end`, as `value` is: a permutation of them that leaves none in place; a range
    /// of one number has no other.
    std::uint64_t permuted(std::string_view purpose, std::uint64_t value, std::uint64_t low, std::uint64_t end);

    /// A number with as many decimal digits; 0 and the numbers whose 8, 16, 28 or 32 bits are all ones, which mostly
    /// say that there is none, stay. `bounds` are further numbers that none goes across.
    std::uint32_t number(std::string_view purpose, std::uint32_t value, std::span<const std::uint64_t> bounds = {});

    /// As many decimal digits; all zeros stay.
    std::string digits(std::string_view purpose, std::string_view digits);

    /// As many bytes; all zeros and all ones stay.
    Bytes octets(std::string_view purpose, ByteView octets);

    /// A text of the same form: letters become letters of their case, digits digits, the rest stays.
    std::string letters(std::string_view purpose, std::string_view text) const;

private:
    std::uint64_t scrambled(std::string_view purpose, std::uint64_t value, std::uint64_t count, bool back) const;

    Secret _secret;
    std::unordered_map<std::string, std::uint64_t> _known;  // of permutations, each worth hundreds of hashes
};

}  // namespace kelvo
