#include "telephony/adaptation/StandIns.h"

#include <algorithm>
#include <array>

namespace kelvo::adaptation {

namespace {

constexpr LogCode kSecondSim = 0xA00;

struct StandIns {
    LogCode code;
    std::array<LogCode, 3> codes;
    std::size_t count;
};

// clang-format off
constexpr std::array<StandIns, 13> kStandIns = {{
    { 0x5072, { 0x5A72 },                 1 },
    { 0x5076, { 0x5A76 },                 1 },
    { 0x512C, { 0x5B2C },                 1 },
    { 0x5134, { 0x5B34 },                 1 },
    { 0x5137, { 0x51FC, 0x5B37, 0x5BFC }, 3 },
    { 0x51F4, { 0x5BF4 },                 1 },
    { 0x51F5, { 0x5BF5 },                 1 },
    { 0x51F6, { 0x5BF6 },                 1 },
    { 0x51F8, { 0x5BF8 },                 1 },
    { 0x51FB, { 0x5BFB },                 1 },
    { 0x51FD, { 0x5BFD },                 1 },
    { 0x51FF, { 0x5BFF },                 1 },
    { 0xB17F, { 0xB193 },                 1 },
}};
// clang-format on

}  // namespace

std::span<const LogCode> codesWithStandIns() {
    static constexpr auto kCodes = [] {
        std::array<LogCode, kStandIns.size()> codes{};
        std::ranges::transform(kStandIns, codes.begin(), &StandIns::code);
        return codes;
    }();
    return kCodes;
}

std::span<const LogCode> standInsFor(LogCode code) {
    const auto found = std::ranges::find(kStandIns, code, &StandIns::code);
    if (found == kStandIns.end()) return {};
    return {found->codes.data(), found->count};
}

LogCode withoutSim(LogCode code) {
    if (code < kSecondSim || (code & 0xF000) != 0x5000) return code;
    const LogCode single = code - kSecondSim;
    const bool isTwin = single == 0x51FC || std::ranges::any_of(kStandIns, [&](const StandIns& standIns) {
                            return standIns.code == single && (single & 0xF000) == 0x5000;
                        });
    return isTwin ? single : code;
}

}  // namespace kelvo::adaptation
