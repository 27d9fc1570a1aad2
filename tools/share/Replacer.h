#pragma once

#include <map>
#include <optional>
#include <set>
#include <span>
#include <string>
#include <string_view>

#include "platform/values/Value.h"
#include "tools/share/Identity.h"
#include "tools/share/Pseudonyms.h"
#include "tools/share/ShareTally.h"

namespace kelvo {

/// Puts pseudonyms in place of identities, in whatever form these come, and counts them under the name of their field.
/// What the user keeps passes as it is. One identity has one pseudonym in all forms: a cell's number in a record and in
/// a text, an address as bytes and with dots, a network's digits in packed BCD and as numbers.
class Replacer {
public:
    Replacer(const ShareChoices& choices, const Pseudonyms::Secret& secret) : _choices(choices), _pseudonyms(secret) {}

    const ShareChoices& choices() const { return _choices; }
    bool hides(Identity identity) const { return isHidden(identity, _choices); }
    ShareTally& tally() { return _tally; }
    const ShareTally& tally() const { return _tally; }

    /// An identity that is a plain number. 24 bits of a temporary one are also.
    std::uint32_t number(Identity identity, std::string_view field, std::uint32_t value);
    /// A text as a screen or a service writes it; none when it is of no form that this identity has.
    std::optional<std::string> text(Identity identity, std::string_view field, const std::string& text);
    /// The content of a SIM's file, or what else comes as bytes.
    std::optional<Bytes> bytes(Identity identity, std::string_view field, ByteView bytes);
    /// Any value: a text, bytes, a number, or a list of such. None when it is of another kind or form.
    Value value(Identity identity, std::string_view field, const Value& value);
    /// Digits in place of the bytes of a list of networks, of which only the first can have its own pseudonym.
    std::string furtherDigits(ByteView list);

private:
    // Without counting.
    std::uint32_t pseudonym(Identity identity, std::uint32_t value);
    std::uint32_t sitedPseudonym(const Sited& sited, std::uint32_t value);
    std::optional<std::string> textOf(Identity identity, const std::string& text);
    std::optional<Bytes> bytesOf(Identity identity, ByteView bytes);

    std::optional<std::string> numberText(Identity identity, const std::string& text);
    std::optional<std::string> hexText(Identity identity, const std::string& text);
    std::string codeText(std::string_view purpose, const std::string& text);
    std::string phoneText(const std::string& text);
    std::string addressText(const std::string& text);
    std::optional<std::string> addressToken(const std::string& token);
    std::string apnText(const std::string& text);

    Bytes bcd(std::string_view purpose, ByteView bytes);
    Bytes phoneFile(ByteView bytes);
    Bytes name(ByteView bytes) const;
    void network(std::span<std::uint8_t> plmn);
    void area(std::span<std::uint8_t> code);
    std::optional<Bytes> networks(ByteView bytes, std::size_t size, bool withAreas);
    Bytes accessClass(ByteView bytes);
    Bytes address(ByteView bytes);
    std::uint32_t address4(std::uint32_t own);

    ShareChoices _choices;
    Pseudonyms _pseudonyms;
    ShareTally _tally;
    std::map<std::uint32_t, std::uint32_t> _addresses;  // of version 4: each has its own for as long as there are some
    std::set<std::uint32_t> _addressesTaken;
};

}  // namespace kelvo
