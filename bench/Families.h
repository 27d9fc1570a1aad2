#pragma once

#include <memory>
#include <string>
#include <string_view>
#include <vector>

#include "LogGenerator/LogGenerator.h"
#include "tests/support/Record.h"

/// What the modems of each technology send: plausible records whose values change from one to the next.
namespace kelvo::bench {

using test::Record;

/// Messages that come in turn, over and over.
struct Traffic {
    std::string name;
    std::vector<Bytes> messages;
};

struct Family {
    std::string name;
    std::string_view technology;
    std::vector<Traffic> traffic;  ///< "mix", and kinds of records alone
};

/// `count` messages of one kind, each made from its number.
template <class Make>
std::vector<Bytes> vary(std::uint32_t count, Make make) {
    std::vector<Bytes> messages;
    for (std::uint32_t i = 0; i < count; ++i) messages.push_back(make(i));
    return messages;
}

/// One message of each kind, in turn.
inline std::vector<Bytes> interleave(const std::vector<std::vector<Bytes>>& kinds) {
    std::vector<Bytes> messages;
    for (std::size_t i = 0; i < kinds.front().size(); ++i) {
        for (const auto& kind : kinds) messages.push_back(kind[i % kind.size()]);
    }
    return messages;
}

/// A packet with `content` as its payload.
inline Bytes withPayload(LogCode code, const Bytes& content) {
    Bytes packet = Record(code, 13).bytes();
    packet.insert(packet.end(), content.begin(), content.end());
    return packet;
}

Family lteFamily();
Family gsmFamily();
Family cdmaFamily();
Family utranFamily();
Family ifxFamily();

/// The records that fill every list of the GSM/UMTS screens.
std::vector<Bytes> fullestGSMScreen();

}  // namespace kelvo::bench
