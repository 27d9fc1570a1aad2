// refused: throw "a constant does not fit its field"
#include "telephony/adaptation/LayoutWords.h"

using namespace kelvo;
using namespace kelvo::adaptation;

constexpr auto kFixed = fixedLayout(4, {{"PCI", 0, u16}, {"RSRP", 2, u16, steps(1, 4, -140)}});
constexpr auto kNewer = newerLayout(kFixed, 2, {{"PCI", 0, u16}, notToBeHad("RSRP", 65536)});
