// accepted: what the others would be without their one mistake
#include "LogGenerator/LTE/LTECodes.h"
#include "LogGenerator/ShowFields.h"

using namespace kelvo;

constexpr auto kRecord =
    record(code::kLTEServingCell, 23, {{20, u8, "Tx Antennas", decimal}, {21, u16, "PCI", decimal}});
constexpr auto kEntry = entry(6, {{0, u16, "PCI", decimal}, {2, u32, "Cell Identity", asSigned}});
constexpr auto kKeys = entry(6, {{0, u16, "PCI", decimal}, {2, u16, "RSRP", decimal}, {4, u16, "RSRQ", decimal}});
constexpr auto kBits = entry(4, {{0, u16.bits(9, 15), "Layer Priority", decimal}, {0, i32, "Level", decimal}});
constexpr auto kReal = entry(2, {{0, u16, "Level", linear(0.25, -140.0, "%4.2f", dBm)}});
constexpr ShownReal kErrorRate("%.2f", percent);
constexpr ValueTable kStates({{0, "Idle"}}, "state %d");
constexpr auto kWhole = entry(2, {{0, i16, "Level", whole(1, 0, dBm, "%4d")}});
constexpr Shown kLevel = whole(1, 0, dBm);

void show(Value& value) { showValue(value, 7, kLevel); }
