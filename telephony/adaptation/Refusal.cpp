#include "telephony/adaptation/Refusal.h"

#include <fmt/format.h>

namespace kelvo::adaptation {

const char* reasonOf(Refusal refusal) {
    switch (refusal) {
        case Refusal::NotKnown: return "not known";
        case Refusal::TooShort: return "too short";
        case Refusal::NotOurs: return "not a code of Kelvo's";
        case Refusal::SecondaryCell: return "a secondary cell's";
        case Refusal::NoServingCell: return "without the primary serving cell";
        case Refusal::NoNeighbors: return "without a neighbor";
        case Refusal::TooManyNeighbors: return "more than 32 neighbors";
        case Refusal::NoNetwork: return "the first network is none";
        case Refusal::LyingSubpackets: return "sub-packets that do not fit";
        case Refusal::DoesNotFit: return "an identity that does not fit";
    }
    return "";
}

std::string describe(const RecordKind& kind) {
    std::string text = fmt::format("0x{:04X}", kind.code);
    if (kind.version) text += fmt::format(" version {}", *kind.version);
    if (kind.partVersion) text += fmt::format(", part 25 version {}", *kind.partVersion);
    return text + fmt::format(", {} bytes", kind.bytes);
}

}  // namespace kelvo::adaptation
