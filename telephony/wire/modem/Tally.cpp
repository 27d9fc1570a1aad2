#include "telephony/wire/modem/Tally.h"

#include <fmt/format.h>

#include <string_view>
#include <utility>

namespace kelvo::modem {

std::string tallyText(const Tally& tally) {
    const std::pair<std::string_view, std::uint64_t> counts[] = {
        {"whole", tally.whole[0]},           {"whole-second-sim", tally.whole[1]},
        {"flipped-bits", tally.flippedBits}, {"cut-frames", tally.cutFrames},
        {"bad-escapes", tally.badEscapes},   {"lying-lengths", tally.lyingLengths},
        {"encrypted", tally.encrypted},      {"cut-off", tally.cutOff},
        {"not-sent", tally.notSent},         {"noise", tally.noise},
        {"oversized", tally.oversized},      {"dropped-texts", tally.droppedTexts},
    };
    std::string text;
    for (const auto& [name, count] : counts) {
        if (count > 0) text += fmt::format("{} {}\n", name, count);
    }
    return text;
}

}  // namespace kelvo::modem
