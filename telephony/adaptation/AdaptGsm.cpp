#include <algorithm>
#include <array>

#include "telephony/adaptation/GsmLayouts.h"
#include "telephony/adaptation/RecordAdapter.h"

namespace kelvo::adaptation {

using namespace gsm;

namespace {

/// The generations of 0x4005: where the list of UMTS cells starts, which the list of GSM cells follows.
struct RankingLayout {
    std::size_t start;
    Turning umts;
    Turning gsm;
};
constexpr std::array<RankingLayout, 3> kRankings = {{
    {2, turning<kRankedUmtsCellV0>, turning<kRankedGsmCellV0>},
    {2, turning<kRankedUmtsCellV1>, turning<kRankedGsmCellV1>},
    {7, turning<kRankedUmtsCellV2>, turning<kRankedGsmCellV2>},
}};
constexpr std::size_t kRankingListsAt = 2;  // in the fixed layout

constexpr std::size_t kCellIdentitySize = 16;
constexpr std::size_t kLongCellIdentitySize = 32;

constexpr std::int64_t kMostNeighbors = 6;

}  // namespace

std::optional<Refusal> RecordAdapter::adaptRanking(ByteView payload) {
    const RecordView record(payload);
    const auto version = static_cast<std::uint8_t>(record.read(0, u8.bits(6, 7)));
    _result.kind.version = version;
    if (version >= kRankings.size() || payload.size() < 2) return Refusal::NotKnown;
    const RankingLayout& layout = kRankings[version];
    const auto umtsCells = static_cast<std::size_t>(record.read(0, u8.bits(0, 5)));
    const auto gsmCells = static_cast<std::size_t>(record.read(1, u8.bits(0, 5)));
    const std::size_t gsmAt = layout.start + umtsCells * layout.umts.size;
    if (payload.size() != gsmAt + gsmCells * layout.gsm.size) return Refusal::NotKnown;
    const bool isFixed = version == 0 && (umtsCells == 0 || gsmCells == 0) && record.read(1, u8) < 64;
    if (isFixed) return passes(), std::nullopt;

    // Both lists start at the same place of the fixed layout: it can say one.
    const bool umts = umtsCells > 0;
    const std::size_t count = umts ? umtsCells : gsmCells;
    const std::size_t fixedSize = umts ? kRankedUmtsCell.size : kRankedGsmCell.size;
    const std::size_t size = kRankingListsAt + count * fixedSize;
    std::fill_n(payloadMade(), size, std::uint8_t{0});
    payloadMade()[umts ? 0 : 1] = static_cast<std::uint8_t>(count);
    for (std::size_t i = 0; i < count; ++i) {
        const std::size_t at = umts ? layout.start + i * layout.umts.size : gsmAt + i * layout.gsm.size;
        std::uint8_t* cell = payloadMade() + kRankingListsAt + i * fixedSize;
        if (!(umts ? layout.umts : layout.gsm).carryOut(payload.subspan(at), cell)) return Refusal::DoesNotFit;
    }
    _result.leftOut = umts ? static_cast<int>(gsmCells) : 0;
    return turned(size, _result.kind.code);
}

std::optional<Refusal> RecordAdapter::adaptCellIdentity(ByteView payload) {
    if (payload.size() == kCellIdentitySize) return passes(), std::nullopt;
    if (payload.size() != kLongCellIdentitySize) return Refusal::NotKnown;
    std::ranges::copy(payload.first(kCellIdentitySize), payloadMade());
    return turned(kCellIdentitySize, _result.kind.code);
}

std::optional<Refusal> RecordAdapter::adaptCells(ByteView payload) {
    const RecordView record(payload);
    const std::int64_t neighbors = record.read(25, u8);
    const auto count = static_cast<std::size_t>(neighbors);
    if (neighbors > kMostNeighbors || payload.size() != kExtendedCells.size + count * kExtendedNeighborCell.size) {
        return Refusal::NotKnown;
    }
    const std::size_t size = kCells.size + count * kNeighborCell.size;
    std::fill_n(payloadMade(), size, std::uint8_t{0});
    bool fits = carryOut<kExtendedCells>(payload, payloadMade());
    for (std::size_t i = 0; i < count; ++i) {
        fits &= carryOut<kExtendedNeighborCell>(payload.subspan(kExtendedCells.size + i * kExtendedNeighborCell.size),
                                                payloadMade() + kCells.size + i * kNeighborCell.size);
    }
    if (!fits) return Refusal::DoesNotFit;
    return turned(size, 0x5137);
}

namespace {

constexpr std::size_t kNetworkCountAt = 3;
constexpr std::size_t kNetworksAt = 4;
constexpr std::size_t kRealNetworksSize = 19;
constexpr std::size_t kMostNetworks = 5;

/// A network as the fixed layout says it: MCC digits at 0, 2, 4 and MNC digits at 1, 3, 5, a MNC of two digits with 0
/// first; none when the digits are no network's. The record has it in packed BCD (3GPP TS 24.008, 10.5.1.13).
using NetworkDigits = std::array<std::uint8_t, 6>;
std::optional<NetworkDigits> networkDigits(ByteView bcd) {
    const auto low = [&](std::size_t i) { return static_cast<std::uint8_t>(bcd[i] & 15); };
    const auto high = [&](std::size_t i) { return static_cast<std::uint8_t>(bcd[i] >> 4); };
    const bool twoDigits = high(1) == 15;
    const NetworkDigits digits = twoDigits ? NetworkDigits{low(0), 0, high(0), low(2), low(1), high(2)}
                                           : NetworkDigits{low(0), low(2), high(0), high(2), low(1), high(1)};
    if (std::ranges::any_of(digits, [](std::uint8_t digit) { return digit > 9; })) return std::nullopt;
    return digits;
}

}  // namespace

std::optional<Refusal> RecordAdapter::adaptNetworks(ByteView payload) {
    if (payload.size() < kNetworksAt) return Refusal::TooShort;
    const std::size_t count = payload[kNetworkCountAt];
    const bool registered = std::ranges::any_of(payload.first(kNetworkCountAt), [](auto byte) { return byte != 0; });
    if (!registered && payload.size() == kNetworksAt + (count == 0 ? 0 : 3 + 3 * count)) return passes(), std::nullopt;
    if (!registered || payload.size() != kRealNetworksSize || count > kMostNetworks) return Refusal::NotKnown;

    // Entries are three bytes apart and six bytes long: the next can follow where it begins as this one ends.
    std::uint8_t* made = payloadMade();
    std::fill_n(made, kNetworksAt, std::uint8_t{0});
    std::size_t said = 0;
    for (; said < count; ++said) {
        const auto digits = networkDigits(payload.subspan(kNetworksAt + 3 * said, 3));
        std::uint8_t* entry = made + kNetworksAt + 3 * said;
        if (!digits && said == 0) return Refusal::NoNetwork;
        if (!digits || (said > 0 && !std::equal(digits->begin(), digits->begin() + 3, entry))) break;
        std::ranges::copy(*digits, entry);
    }
    made[kNetworkCountAt] = static_cast<std::uint8_t>(said);
    _result.leftOut = static_cast<int>(count - said);
    return turned(kNetworksAt + (said == 0 ? 0 : 3 + 3 * said), _result.kind.code);
}

}  // namespace kelvo::adaptation
