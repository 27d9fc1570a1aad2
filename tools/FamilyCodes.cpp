#include "tools/FamilyCodes.h"

#include <algorithm>

#include "LogGenerator/Framing.h"
#include "platform/telephony/LogChannelProtocol.h"
#include "platform/values/Array.h"
#include "tools/QuietDecoder.h"

namespace kelvo {

namespace {

constexpr std::uint8_t kOrdinary = 1;
constexpr std::uint8_t kExtended = 255;

void append(std::vector<LogCode>& codes, const Value& list, LogCode space) {
    if (!list.array()) return;
    for (const Value& code : *list.array()) {
        if (code.number() != nullptr) codes.push_back(space | static_cast<LogCode>(code.number()->integer()));
    }
}

}  // namespace

FamilyCodes::FamilyCodes(const Dictionary& startCommand) {
    const Value& ordinary = startCommand[kPLSetOskraLogCodes];
    const Value& extended = startCommand[kPLSetPlExtraCodes];
    if (!ordinary && !extended) return;
    _codes.emplace();
    append(*_codes, ordinary, 0);
    append(*_codes, extended, kExtendedLogCodes);
    std::ranges::sort(*_codes);
}

FamilyCodes FamilyCodes::of(Technology technology) {
    const QuietDecoder decoder(technology);
    return FamilyCodes(*decoder.generator().getStartCommand());
}

bool FamilyCodes::include(ByteView message) const {
    if (!_codes) return true;
    const ByteView packet = stripPrefix(message);
    if (message.size() < kMinimumMessageSize || (packet[0] != kOrdinary && packet[0] != kExtended)) return false;
    return std::ranges::binary_search(*_codes, logCode(packet.data()));
}

}  // namespace kelvo
