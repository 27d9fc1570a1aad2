// refused: throw "the fixed layout has no field of this name"
#include "telephony/adaptation/LayoutWords.h"

using namespace kelvo;
using namespace kelvo::adaptation;

constexpr auto kFixed = fixedLayout(4, {{"PCI", 0, u16}, {"RSRP", 2, u16, steps(1, 4, -140)}});
constexpr FixedField kRsrq = kFixed.field("RSRQ");
