#include "tools/share/Identity.h"

namespace kelvo {

bool isHidden(Identity identity, const ShareChoices& choices) {
    if (identity == Identity::None) return false;
    if (identity < Identity::Apn) return true;
    return identity == Identity::Apn ? choices.hideApns : choices.hideCells;
}

namespace {

// 65534 is an area that was deleted (3GPP TS 23.003, 4.1). Technology types of reselection candidates end at 4, and one
// may stand where the identity of the candidate before it does.
constexpr std::uint64_t kArea[] = {65534};
constexpr std::uint64_t kPhysicalCell[] = {5, 504, 512};
constexpr std::uint64_t kScramblingCode[] = {5, 512, 8192};
constexpr std::uint64_t kBsic[] = {64};
constexpr std::uint64_t kColour[] = {8};
constexpr std::uint64_t kPilot[] = {5, 512};
constexpr std::uint64_t kCellParameter[] = {128, 16384};
// Between them the whole numbers have as many digits, but for those of a site on the border. The last of all is none.
constexpr std::uint64_t kENodeB[] = {1, 391, 3907, 39063, 390625, 0xFFFFF, 0x100000};
constexpr std::uint64_t kRnc[] = {1, 16, 153, 1526, 0xFFF, 0x1000};

}  // namespace

std::span<const std::uint64_t> boundsOf(Identity identity) {
    switch (identity) {
        case Identity::Area: return kArea;
        case Identity::PhysicalCell: return kPhysicalCell;
        case Identity::ScramblingCode: return kScramblingCode;
        case Identity::Bsic: return kBsic;
        case Identity::Colour: return kColour;
        case Identity::Pilot: return kPilot;
        case Identity::CellParameter: return kCellParameter;
        default: return {};
    }
}

std::optional<Sited> sitedOf(Identity identity) {
    if (identity == Identity::EutranCell) return Sited{"eNB", "sector", 8, kENodeB};
    if (identity == Identity::UtranCell) return Sited{"RNC", "cell of an RNC", 16, kRnc};
    return std::nullopt;
}

std::string_view nameOf(Identity identity) {
    switch (identity) {
        case Identity::None: break;
        case Identity::SimNumber: return "SIM number";
        case Identity::Phone: return "telephone number";
        case Identity::Subscriber: return "subscriber";
        case Identity::Equipment: return "equipment";
        case Identity::Temporary: return "temporary identity";
        case Identity::AccessClass: return "access class";
        case Identity::Address: return "address";
        case Identity::Location:
        case Identity::PsLocation: return "temporary identity and area";
        case Identity::Apn: return "access point";
        case Identity::Country: return "country";
        case Identity::Network: return "network";
        case Identity::Area:
        case Identity::SubArea: return "area";
        case Identity::Cell:
        case Identity::EutranCell:
        case Identity::UtranCell: return "cell";
        case Identity::PhysicalCell:
        case Identity::ScramblingCode:
        case Identity::Bsic:
        case Identity::Colour:
        case Identity::Pilot:
        case Identity::CellParameter: return "cell's code";
        case Identity::System: return "system";
        case Identity::Plmn:
        case Identity::PlmnAccess: return "networks";
        case Identity::PlmnAreas: return "networks and areas";
        case Identity::NetworkName: return "network's name";
    }
    return "harmless";
}

}  // namespace kelvo
