// accepted: what the others would be without their one mistake
#include "telephony/adaptation/LayoutWords.h"

using namespace kelvo;
using namespace kelvo::adaptation;

constexpr auto kFixed = fixedLayout(4, {{"PCI", 0, u16}, {"RSRP", 2, u16, steps(1, 4, -140)}});
constexpr auto kNewer = newerLayout(kFixed, 4, {{"RSRP", 2, i16, steps(1, 16, -180)}, {"PCI", 0, u16}});
constexpr auto kPoorer = newerLayout(kFixed, 2, {{"PCI", 0, u16}, notToBeHad("RSRP", 65535)});
constexpr FixedField kPci = kFixed.field("PCI");
constexpr auto kBits = fixedLayout(2, {{"PCI", 0, u16.bits(0, 8)}, {"layer priority", 0, u16.bits(9, 12)}});
