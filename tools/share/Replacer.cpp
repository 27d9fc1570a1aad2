#include "tools/share/Replacer.h"

#include <algorithm>

namespace kelvo {

std::uint32_t Replacer::pseudonym(Identity identity, std::uint32_t value) {
    const auto sited = sitedOf(identity);
    if (sited && value >> sited->partBits != 0 && value >> 28 == 0) return sitedPseudonym(*sited, value);
    if (identity != Identity::Temporary) return _pseudonyms.number(nameOf(identity), value, boundsOf(identity));
    const std::uint8_t octets[] = {static_cast<std::uint8_t>(value >> 16), static_cast<std::uint8_t>(value >> 8),
                                   static_cast<std::uint8_t>(value)};
    const Bytes other = _pseudonyms.octets(nameOf(identity), octets);
    return std::uint32_t{other[0]} << 16 | std::uint32_t{other[1]} << 8 | other[2];
}

/// Parts of one site stay parts of one site, in places that are others on every site.
std::uint32_t Replacer::sitedPseudonym(const Sited& sited, std::uint32_t value) {
    const std::uint32_t parts = 1U << sited.partBits;
    const std::uint32_t site = value / parts;
    const auto above = std::ranges::upper_bound(sited.bounds, std::uint64_t{site});
    const std::uint64_t other = _pseudonyms.permuted(sited.site, site, *(above - 1), *above);
    const bool isLast = site == sited.bounds.back() - 1;
    if (isLast && value % parts == parts - 1) return value;
    const std::string purpose = std::string(sited.part) + ' ' + std::to_string(site);
    const std::uint64_t part = _pseudonyms.permuted(purpose, value % parts, 0, isLast ? parts - 1 : parts);
    return static_cast<std::uint32_t>(other * parts + part);
}

std::uint32_t Replacer::number(Identity identity, std::string_view field, std::uint32_t value) {
    if (!hides(identity)) return value;
    const std::uint32_t other = pseudonym(identity, value);
    if (other != value) _tally.replaced(field, identity);
    return other;
}

std::optional<std::string> Replacer::text(Identity identity, std::string_view field, const std::string& text) {
    if (text.empty() || identity == Identity::None) return text;
    if (!hides(identity) && identity != Identity::Apn) return text;
    std::optional<std::string> other = textOf(identity, text);
    if (other && *other != text) _tally.replaced(field, identity);
    return other;
}

std::optional<Bytes> Replacer::bytes(Identity identity, std::string_view field, ByteView bytes) {
    Bytes same(bytes.begin(), bytes.end());
    if (identity == Identity::None) return same;
    if (!hides(identity) && identity != Identity::Apn) return same;
    std::optional<Bytes> other = bytesOf(identity, bytes);
    if (other && *other != same) _tally.replaced(field, identity);
    return other;
}

Value Replacer::value(Identity identity, std::string_view field, const Value& value) {
    if (const std::string* words = value.string()) {
        const auto other = text(identity, field, *words);
        return other ? Value(*other) : Value();
    }
    if (const Bytes* content = value.data()) {
        auto other = bytes(identity, field, *content);
        return other ? Value(std::move(*other)) : Value();
    }
    if (const Number* number = value.number(); number != nullptr && !number->isReal()) {
        if (!hides(identity)) return value;
        const auto other = text(identity, field, std::to_string(number->integer()));
        if (!other || other->size() > 18) return {};
        return Value(std::int64_t{std::strtoll(other->c_str(), nullptr, 10)});
    }
    if (!value.array()) return {};
    const ArrayRef list = Array::make();
    for (const Value& element : *value.array()) {
        if (element.array()) return {};
        if (Value other = this->value(identity, field, element)) list->append(std::move(other));
    }
    return list;
}

std::string Replacer::furtherDigits(ByteView list) {
    std::string digits;
    for (std::size_t i = 0; i < list.size(); ++i) {
        digits += static_cast<char>('0' + (list[i] + 1 + _pseudonyms.hash("networks", list, i) % 9) % 10);
    }
    return digits;
}

// A value of several networks stands as one; it has one count whatever is in it.
std::optional<Bytes> Replacer::bytesOf(Identity identity, ByteView bytes) {
    constexpr std::size_t kLocation = 11;    // TMSI, area of three and two bytes, a byte, status
    constexpr std::size_t kPsLocation = 14;  // P-TMSI and its signature, area of three, two and one byte, status
    Bytes made(bytes.begin(), bytes.end());
    const std::span<std::uint8_t> all(made);
    const auto temporary = [&](std::size_t at, std::size_t size) {
        const Bytes other = _pseudonyms.octets(nameOf(Identity::Temporary), all.subspan(at, size));
        std::ranges::copy(other, made.begin() + static_cast<std::ptrdiff_t>(at));
    };
    const auto where = [&](std::size_t at) {
        network(all.subspan(at, 3));
        area(all.subspan(at + 3, 2));
    };
    switch (identity) {
        case Identity::SimNumber:
        case Identity::Subscriber:
        case Identity::Equipment: return bcd(nameOf(identity), bytes);
        case Identity::Phone: return phoneFile(bytes);
        case Identity::Temporary: return _pseudonyms.octets(nameOf(identity), bytes);
        case Identity::AccessClass: return accessClass(bytes);
        case Identity::Address: return address(bytes);
        case Identity::Location:
            if (bytes.size() != kLocation) return std::nullopt;
            temporary(0, 4);
            where(4);
            return made;
        case Identity::PsLocation:
            if (bytes.size() != kPsLocation) return std::nullopt;
            temporary(0, 4);
            temporary(4, 3);
            where(7);
            if (hides(Identity::SubArea)) made[12] = static_cast<std::uint8_t>(pseudonym(Identity::SubArea, made[12]));
            return made;
        case Identity::Apn: {
            const std::string text = apnText(std::string(bytes.begin(), bytes.end()));
            return Bytes(text.begin(), text.end());
        }
        case Identity::NetworkName: return name(bytes);
        case Identity::Plmn: return networks(bytes, 3, false);
        case Identity::PlmnAccess: return networks(bytes, 5, false);
        case Identity::PlmnAreas: return networks(bytes, 8, true);
        default: return std::nullopt;
    }
}

/// Digits in nibbles, the low one first; what is no digit stays.
Bytes Replacer::bcd(std::string_view purpose, ByteView bytes) {
    std::string digits;
    for (const std::uint8_t byte : bytes) {
        for (const int nibble : {byte & 15, byte >> 4}) {
            if (nibble < 10) digits += static_cast<char>('0' + nibble);
        }
    }
    digits = _pseudonyms.digits(purpose, digits);
    Bytes made(bytes.begin(), bytes.end());
    std::size_t next = 0;
    for (std::uint8_t& byte : made) {
        const int low = (byte & 15) < 10 ? digits[next++] - '0' : byte & 15;
        const int high = byte >> 4 < 10 ? digits[next++] - '0' : byte >> 4;
        byte = static_cast<std::uint8_t>(low | high << 4);
    }
    return made;
}

/// EF-MSISDN and its like (3GPP TS 31.102, 4.2.26): a name, then 14 bytes: length, type of number, ten of digits, two
/// references. Anything else is digits alone.
Bytes Replacer::phoneFile(ByteView bytes) {
    constexpr std::size_t kBehindName = 14;
    constexpr std::size_t kDigitsAt = 2;
    constexpr std::size_t kDigits = 10;
    if (bytes.size() < kBehindName) return bcd(nameOf(Identity::Phone), bytes);
    Bytes made(bytes.begin(), bytes.end());
    const std::size_t nameSize = bytes.size() - kBehindName;
    std::ranges::copy(name(bytes.first(nameSize)), made.begin());
    const Bytes digits = bcd(nameOf(Identity::Phone), bytes.subspan(nameSize + kDigitsAt, kDigits));
    std::ranges::copy(digits, made.begin() + static_cast<std::ptrdiff_t>(nameSize + kDigitsAt));
    return made;
}

/// A text in whatever alphabet: letters in its place, but for fillers.
Bytes Replacer::name(ByteView bytes) const {
    Bytes made(bytes.begin(), bytes.end());
    for (std::size_t i = 0; i < made.size(); ++i) {
        const auto letter = static_cast<std::uint8_t>('a' + _pseudonyms.hash("name", bytes, i) % 25);
        if (made[i] != 0xFF) made[i] = letter == made[i] ? 'z' : letter;
    }
    return made;
}

/// Three bytes of packed BCD (3GPP TS 24.008, 10.5.1.3); what are no digits stays.
void Replacer::network(std::span<std::uint8_t> plmn) {
    if (!hides(Identity::Country)) return;
    const int country[] = {plmn[0] & 15, plmn[0] >> 4, plmn[1] & 15};
    const int network[] = {plmn[2] & 15, plmn[2] >> 4, plmn[1] >> 4};
    const int networkDigits = network[2] == 15 ? 2 : 3;
    const auto valueOf = [](std::span<const int> digits) {
        std::uint32_t value = 0;
        for (const int digit : digits) value = value * 10 + static_cast<std::uint32_t>(std::min(digit, 9));
        return value;
    };
    const std::uint32_t c = pseudonym(Identity::Country, valueOf(country));
    const std::uint32_t n = pseudonym(Identity::Network, valueOf(std::span(network).first(networkDigits)));
    if (std::ranges::all_of(country, [](int digit) { return digit > 9; })) return;  // empty
    const auto digit = [](std::uint32_t value, std::uint32_t unit) {
        return static_cast<std::uint8_t>(value / unit % 10);
    };
    plmn[0] = static_cast<std::uint8_t>(digit(c, 100) | digit(c, 10) << 4);
    const std::uint8_t third = networkDigits == 2 ? 15 : digit(n, 1);
    plmn[1] = static_cast<std::uint8_t>(digit(c, 1) | third << 4);
    const std::uint32_t first = networkDigits == 2 ? 10 : 100;
    plmn[2] = static_cast<std::uint8_t>(digit(n, first) | digit(n, first / 10) << 4);
}

/// Two bytes, the high one first.
void Replacer::area(std::span<std::uint8_t> code) {
    if (!hides(Identity::Area)) return;
    const std::uint32_t other = pseudonym(Identity::Area, std::uint32_t{code[0]} << 8 | code[1]);
    code[0] = static_cast<std::uint8_t>(other >> 8);
    code[1] = static_cast<std::uint8_t>(other);
}

std::optional<Bytes> Replacer::networks(ByteView bytes, std::size_t size, bool withAreas) {
    if (bytes.size() % size != 0) return std::nullopt;
    Bytes made(bytes.begin(), bytes.end());
    for (std::size_t at = 0; at < made.size(); at += size) {
        network(std::span(made).subspan(at, 3));
        if (!withAreas) continue;
        area(std::span(made).subspan(at + 3, 2));
        area(std::span(made).subspan(at + 5, 2));
    }
    return made;
}

/// Classes 0 to 9, bits of the second byte and of the first's lowest two, change places; 11 to 15 are no one's own.
Bytes Replacer::accessClass(ByteView bytes) {
    Bytes made(bytes.begin(), bytes.end());
    if (bytes.size() != 2) return Bytes(bytes.size());
    const unsigned classes = made[1] | (made[0] & 3U) << 8;
    unsigned other = 0;
    for (unsigned i = 0; i < 10; ++i) {
        if ((classes >> i & 1) != 0) other |= 1U << _pseudonyms.permuted(nameOf(Identity::AccessClass), i, 0, 10);
    }
    made[0] = static_cast<std::uint8_t>((made[0] & 0xFC) | other >> 8);
    made[1] = static_cast<std::uint8_t>(other);
    return made;
}

/// One of the ranges for documentation (RFC 5737, RFC 3849), or, when those of version 4 are used up, of the one for
/// benchmarks (RFC 2544).
Bytes Replacer::address(ByteView bytes) {
    Bytes own(bytes.begin(), bytes.end());
    if (std::ranges::all_of(own, [](std::uint8_t byte) { return byte == 0; })) return own;
    if (own.size() == 16) {
        Bytes made = {0x20, 0x01, 0x0D, 0xB8};
        for (std::uint64_t i = 0; made.size() < 16; ++i) {
            made.push_back(static_cast<std::uint8_t>(_pseudonyms.hash("address", bytes, i)));
        }
        return made;
    }
    if (own.size() != 4) return Bytes(own.size());
    std::uint32_t word = 0;
    for (const std::uint8_t byte : own) word = word << 8 | byte;
    word = address4(word);
    for (std::size_t i = 4; i > 0; --i, word >>= 8) own[i - 1] = static_cast<std::uint8_t>(word);
    return own;
}

std::uint32_t Replacer::address4(std::uint32_t own) {
    constexpr std::uint32_t kHosts = 254;
    constexpr std::uint32_t kRanges[] = {0xC0000200, 0xC6336400, 0xCB007100};
    constexpr std::uint32_t kPlaces = 3 * kHosts;
    constexpr std::uint32_t kBenchmarks = 0xC6120000;
    const auto known = _addresses.find(own);
    if (known != _addresses.end()) return known->second;
    const std::uint64_t start = _pseudonyms.hash("address", {}, own);
    if (_addresses.size() >= kPlaces - 1) return kBenchmarks | (start & 0x1FFFF);
    for (std::uint64_t i = 0;; ++i) {
        const std::uint64_t place = (start + i) % kPlaces;
        const auto made = static_cast<std::uint32_t>(kRanges[place / kHosts] + 1 + place % kHosts);
        if (made == own || !_addressesTaken.insert(made).second) continue;
        _addresses.emplace(own, made);
        return made;
    }
}

}  // namespace kelvo
