#include <algorithm>

#include "telephony/adaptation/DerivedIdle.h"
#include "telephony/adaptation/LteLayouts.h"
#include "telephony/adaptation/RecordAdapter.h"

namespace kelvo::adaptation {

using namespace lte;

namespace {

constexpr LogCode kIdleCode = 0xB17F;
constexpr std::int64_t kChannelSaidElsewhere = 65535;

constexpr FixedField kPci = kIdle.field("PCI");
constexpr FixedField kEarfcn = kIdle.field("EARFCN");

std::int64_t read(const FixedField& field, RecordView payload) { return payload.read(field.at, field.raw); }

}  // namespace

std::optional<Refusal> RecordAdapter::adaptIdle(ByteView payload) {
    const RecordView record(payload);
    const auto version = static_cast<std::uint8_t>(record.read(0, u8));
    _result.kind.version = version;
    if (version < 3) {
        if (payload.size() != kIdle.size) return Refusal::NotKnown;
        // 65535 does not tell which channel it is.
        if (const std::int64_t earfcn = read(kEarfcn, record); earfcn != kChannelSaidElsewhere) {
            _idleCells.remember(static_cast<std::uint32_t>(earfcn), static_cast<std::uint16_t>(read(kPci, record)),
                                payload.data());
        }
        return passes(), std::nullopt;
    }
    const auto flag = static_cast<std::size_t>(record.read(1, u8));
    if (version > 5 || flag > 1) return Refusal::NotKnown;
    const bool wide = version == 5;
    if (payload.size() != (wide ? kIdleV5.size : kIdleV3.size) + flag * kRelease9Word) return Refusal::NotKnown;
    const auto refusal =
        wide ? turn(turning<kIdleV5>, payload, kIdle.size) : turn(turning<kIdleV3>, payload, kIdle.size);
    if (!refusal) {
        _idleCells.remember(static_cast<std::uint32_t>(record.read(4, wide ? u32 : u16)),
                            static_cast<std::uint16_t>(read(kPci, RecordView(_result.packet.subspan(kHeader)))),
                            payloadMade());
    }
    return refusal;
}

namespace {

constexpr std::uint8_t kServingCellPart = 25;
constexpr std::size_t kPartHeader = 4;

/// The generations of part 25: its body's size, where the first cell is and how far apart the places for cells are.
struct AnyModeLayout {
    std::uint8_t version;
    Turning body;
    std::size_t firstCell;
    std::size_t stride;
    bool isList;  // a count of cells at 4, and a bit that marks the serving one
};
constexpr auto kAnyModeLayouts = std::to_array<AnyModeLayout>({
    {18, turning<kAnyModeV18>, 4, 88, false},
    {19, turning<kAnyModeV19>, 8, 88, true},
    {36, turning<kAnyModeV36>, 8, 128, true},
});
constexpr std::int64_t kCellPlaces = 4;

/// The first part 25 of a container whose parts fill it exactly, with its header; empty when there is none.
ByteView servingCellPart(ByteView payload) {
    const RecordView record(payload);
    ByteView found;
    std::size_t at = 4;
    for (std::int64_t left = record.read(1, u8); left > 0; --left) {
        if (payload.size() < at + kPartHeader) return {};
        const auto size = static_cast<std::size_t>(record.read(at + 2, u16));
        if (size < kPartHeader || size > payload.size() - at) return {};
        if (found.empty() && payload[at] == kServingCellPart) found = payload.subspan(at, size);
        at += size;
    }
    return at == payload.size() ? found : ByteView();
}

}  // namespace

std::optional<Refusal> RecordAdapter::adaptAnyMode(ByteView payload) {
    const RecordView record(payload);
    _result.kind.version = static_cast<std::uint8_t>(record.read(0, u8));
    if (_result.kind.version != 1) return Refusal::NotKnown;
    const ByteView part = servingCellPart(payload);
    if (part.empty()) return Refusal::NotKnown;
    _result.kind.partVersion = part[1];
    _result.kind.bytes = part.size();

    const ByteView body = part.subspan(kPartHeader);
    const auto layout = std::ranges::find(kAnyModeLayouts, part[1], &AnyModeLayout::version);
    if (layout == kAnyModeLayouts.end() || body.size() != layout->body.size) return Refusal::NotKnown;
    const RecordView view(body);
    const std::int64_t cells = layout->isList ? view.read(4, u16) : 1;
    if (cells < 1 || cells > kCellPlaces) return Refusal::NotKnown;
    for (std::int64_t i = 0; i < cells; ++i) {
        const std::size_t at = layout->firstCell + static_cast<std::size_t>(i) * layout->stride;
        const bool isPrimary = view.read(at, u16.bits(9, 11)) == 0;
        const bool isServing = !layout->isList || view.read(at, u16.bit(12)) == 1;
        if (!isPrimary || !isServing) continue;
        if (i == 0) return deriveIdle(body, layout->body);
        // The layout has the places of the first cell: the part's own fields and then this cell's.
        std::array<std::uint8_t, 8 + 128> cell{};
        std::copy_n(body.begin(), layout->firstCell, cell.begin());
        std::copy_n(body.begin() + static_cast<std::ptrdiff_t>(at), layout->stride,
                    cell.begin() + static_cast<std::ptrdiff_t>(layout->firstCell));
        return deriveIdle(ByteView(cell), layout->body);
    }
    return Refusal::NoServingCell;
}

/// A 0xB17F of what a cell of the part says, completed by the cell's last real 0xB17F.
std::optional<Refusal> RecordAdapter::deriveIdle(ByteView cell, const Turning& layout) {
    std::uint8_t* made = payloadMade();
    std::fill_n(made, kIdle.size, std::uint8_t{0});
    const RecordView source(cell);
    if (!layout.carryOut(cell, made)) return Refusal::DoesNotFit;
    const auto earfcn = static_cast<std::uint32_t>(source.read(0, u32));
    tellChannel(earfcn);

    const RecordView now(ByteView(made, kIdle.size));
    const IdleCells::Payload* last = _idleCells.recall(earfcn, static_cast<std::uint16_t>(read(kPci, now)));
    _result.derivation = last != nullptr ? Adapted::Derivation::Completed : Adapted::Derivation::Neutral;
    if (last != nullptr) completeIdle(made, *last);
    return turned(kIdle.size, kIdleCode);
}

}  // namespace kelvo::adaptation
