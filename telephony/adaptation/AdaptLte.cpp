#include <algorithm>

#include "telephony/adaptation/LteLayouts.h"
#include "telephony/adaptation/RecordAdapter.h"

namespace kelvo::adaptation {

using namespace lte;

std::optional<Refusal> RecordAdapter::adaptMasterInformation(ByteView payload) {
    const RecordView record(payload);
    const auto version = static_cast<std::uint8_t>(record.read(0, u8));
    _result.kind.version = version;
    if (version == 1 && payload.size() == kMasterInformation.size) return passes(), std::nullopt;
    if (version == 2 && payload.size() == kMasterInformationV2.size) {
        return turn(turning<kMasterInformationV2>, payload, kMasterInformation.size);
    }
    if (version == 3 && payload.size() == kMasterInformationV3.size) {
        return turn(turning<kMasterInformationV3>, payload, kMasterInformation.size);
    }
    if (version == 17 && payload.size() == kMasterInformationV17.size) {
        return turn(turning<kMasterInformationV17>, payload, kMasterInformation.size);
    }
    return Refusal::NotKnown;
}

std::optional<Refusal> RecordAdapter::adaptServingCell(ByteView payload) {
    const auto version = static_cast<std::uint8_t>(RecordView(payload).read(0, u8));
    _result.kind.version = version;
    if (version == 2 && payload.size() == kServingCell.size) return passes(), std::nullopt;
    if (version == 3 && payload.size() == kServingCellV3.size)
        return turn(turning<kServingCellV3>, payload, kServingCell.size);
    return Refusal::NotKnown;
}

namespace {

/// The generations of 0xB179: where the lists start and what their entries are.
struct ConnectedLayout {
    Turning header;
    std::size_t countsAt;
    Turning detected;
};
constexpr ConnectedLayout kConnected3{turning<kConnectedV3>, 22, turning<kDetectedCellV3>};
constexpr ConnectedLayout kConnected4{turning<kConnectedV4>, 24, turning<kDetectedCellV4>};
constexpr std::size_t kServingCellIndexAt = 4;

}  // namespace

std::optional<Refusal> RecordAdapter::adaptConnected(ByteView payload) {
    const RecordView record(payload);
    const auto version = static_cast<std::uint8_t>(record.read(0, u8));
    _result.kind.version = version;
    const auto count = [&](std::size_t at) { return static_cast<std::size_t>(record.read(at, u8)); };
    if (version < 3) {
        const std::size_t size = kConnected.size + count(14) * kMeasuredCell.size + count(15) * kDetectedCell.size;
        if (payload.size() != size) return Refusal::NotKnown;
        return passes(), std::nullopt;
    }
    if (version > 4) return Refusal::NotKnown;

    const ConnectedLayout& layout = version == 3 ? kConnected3 : kConnected4;
    const std::size_t measured = count(layout.countsAt);
    const std::size_t detected = count(layout.countsAt + 1);
    const std::size_t detectedAt = layout.header.size + measured * kMeasuredCellV3.size;
    if (payload.size() != detectedAt + detected * kDetectedCellV3.size) return Refusal::NotKnown;
    if (record.read(kServingCellIndexAt, u8) != 0) return Refusal::SecondaryCell;

    const std::size_t fixedDetectedAt = kConnected.size + measured * kMeasuredCell.size;
    const std::size_t size = fixedDetectedAt + detected * kDetectedCell.size;
    std::fill_n(payloadMade(), size, std::uint8_t{0});
    bool fits = layout.header.carryOut(payload, payloadMade());
    for (std::size_t i = 0; i < measured; ++i) {
        fits &= carryOut<kMeasuredCellV3>(payload.subspan(layout.header.size + i * kMeasuredCellV3.size),
                                          payloadMade() + kConnected.size + i * kMeasuredCell.size);
    }
    for (std::size_t i = 0; i < detected; ++i) {
        fits &= layout.detected.carryOut(payload.subspan(detectedAt + i * kDetectedCellV3.size),
                                         payloadMade() + fixedDetectedAt + i * kDetectedCell.size);
    }
    if (!fits) return Refusal::DoesNotFit;
    if (version == 4) tellChannel(record.read(8, u32));
    return turned(size, _result.kind.code);
}

std::optional<Refusal> RecordAdapter::adaptNeighbors(ByteView payload) {
    const RecordView record(payload);
    const auto version = static_cast<std::uint8_t>(record.read(0, u8));
    _result.kind.version = version;
    const auto number = [&](std::size_t at, Raw raw) { return static_cast<std::size_t>(record.read(at, raw)); };
    if (version < 4) {
        const std::size_t cells = number(kNeighborCountLessOne.at, kNeighborCountLessOne.raw) + 1;
        if (payload.size() != kNeighbors.size + cells * kNeighbor.size) return Refusal::NotKnown;
        return passes(), std::nullopt;
    }
    const std::size_t flag = number(1, u8);
    if (version > 5 || flag > 1) return Refusal::NotKnown;

    const bool wide = version == 5;  // a channel of 32 bits
    const std::size_t start = wide ? kNeighborsV5.size : kNeighborsV4.size;
    const std::size_t places = wide ? number(8, u32.bits(6, 31)) : number(6, u16.bits(6, 15));
    const std::size_t stride = kNeighborV4.size + 4 * flag;
    if (payload.size() < start || payload.size() - start != places * stride) return Refusal::NotKnown;

    const auto isEmpty = [&](std::size_t place) {  // its first 24 bytes say nothing
        return std::ranges::all_of(payload.subspan(start + place * stride, 24), [](auto byte) { return byte == 0; });
    };
    std::size_t cells = 0;
    for (std::size_t place = 0; place < places; ++place) cells += isEmpty(place) ? 0 : 1;
    if (cells == 0) return Refusal::NoNeighbors;
    if (cells > 32) return Refusal::TooManyNeighbors;

    const std::size_t size = kNeighbors.size + cells * kNeighbor.size;
    std::fill_n(payloadMade(), size, std::uint8_t{0});
    bool fits = wide ? carryOut<kNeighborsV5>(payload, payloadMade()) : carryOut<kNeighborsV4>(payload, payloadMade());
    writeBits(payloadMade() + kNeighborCountLessOne.at, kNeighborCountLessOne.raw,
              static_cast<std::uint32_t>(cells - 1));
    std::uint8_t* cell = payloadMade() + kNeighbors.size;
    for (std::size_t place = 0; place < places; ++place) {
        if (isEmpty(place)) continue;
        fits &= carryOut<kNeighborV4>(payload.subspan(start + place * stride), cell);
        cell += kNeighbor.size;
    }
    if (!fits) return Refusal::DoesNotFit;
    if (wide) tellChannel(record.read(4, u32));
    return turned(size, _result.kind.code);
}

}  // namespace kelvo::adaptation
