#include "telephony/adaptation/DerivedIdle.h"

#include <algorithm>
#include <cmath>

#include "telephony/adaptation/CarryOut.h"
#include "telephony/adaptation/LteLayouts.h"

namespace kelvo::adaptation {

using namespace lte;

namespace {

constexpr std::uint32_t kChannelSaidElsewhere = 65535;
constexpr int kNoDemand = -140;  // dBm: Qrxlevmin 0

constexpr FixedField kMeasuredRsrp = kIdle.field("measured RSRP");
constexpr FixedField kAveragedRsrp = kIdle.field("averaged RSRP");
constexpr FixedField kMeasuredRsrq = kIdle.field("measured RSRQ");
constexpr FixedField kAveragedRsrq = kIdle.field("averaged RSRQ");
constexpr FixedField kRssi = kIdle.field("RSSI");
constexpr FixedField kEarfcn = kIdle.field("EARFCN");
constexpr FixedField kPci = kIdle.field("PCI");
constexpr FixedField kSrxlev = kIdle.field("Srxlev");

/// What the levels do not say and the last 0xB17F of the cell does.
constexpr auto kRemembered = std::to_array<FixedField>({
    kIdle.field("layer priority"),
    kIdle.field("Qrxlevmin"),
    kIdle.field("P_Max"),
    kIdle.field("maximum power"),
    kIdle.field("DRX cycles"),
    kIdle.field("S intra"),
    kIdle.field("S non intra"),
    kIdle.field("rules updated"),
    kIdle.field("rules"),
});

std::int64_t read(const FixedField& field, RecordView payload) { return payload.read(field.at, field.raw); }

void write(std::uint8_t* to, const FixedField& field, std::int64_t raw) {
    const std::int64_t greatest = (std::int64_t{1} << field.raw.bitWidth()) - 1;
    writeBits(to + field.at, field.raw, static_cast<std::uint32_t>(std::clamp<std::int64_t>(raw, 0, greatest)));
}

void writeLevel(std::uint8_t* to, const FixedField& field, double value) {
    const double steps = (value - field.steps.offset) * field.steps.denominator / field.steps.numerator;
    write(to, field, static_cast<std::int64_t>(std::floor(std::clamp(steps, -1e6, 1e6) + 0.5)));
}

std::int64_t roundedQuarters(std::int64_t quarters) { return (quarters + 2) >> 2; }  // ties up

}  // namespace

void completeIdle(std::uint8_t* made, const IdleCells::Payload& last) {
    const RecordView now(ByteView(made, kIdle.size));
    const RecordView then{ByteView(last)};
    for (const FixedField& field : kRemembered) write(made, field, read(field, then));
    const std::int64_t moved = roundedQuarters(read(kMeasuredRsrp, now) - read(kMeasuredRsrp, then));
    write(made, kSrxlev, read(kSrxlev, then) + moved);
}

IdleCells::Payload derivedIdle(const ServingLevels& levels, const IdleCells::Payload* last) {
    IdleCells::Payload made{};
    for (const Move& move : kAnyModeV18.moves) {  // the neutral values
        if (move.turn == Turn::Constant)
            writeBits(made.data() + move.to, move.toRaw, static_cast<std::uint32_t>(move.summand));
    }
    write(made.data(), kEarfcn, std::min(levels.earfcn, kChannelSaidElsewhere));
    write(made.data(), kPci, levels.pci);
    for (const FixedField& field : {kMeasuredRsrp, kAveragedRsrp}) writeLevel(made.data(), field, levels.rsrp);
    for (const FixedField& field : {kMeasuredRsrq, kAveragedRsrq}) writeLevel(made.data(), field, levels.rsrq);
    writeLevel(made.data(), kRssi, levels.rssi);
    writeLevel(made.data(), kSrxlev, levels.rsrp - kNoDemand);
    if (last != nullptr) completeIdle(made.data(), *last);
    return made;
}

}  // namespace kelvo::adaptation
