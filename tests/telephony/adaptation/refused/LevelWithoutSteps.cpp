// refused: throw "the newer field has no steps"
#include "telephony/adaptation/LayoutWords.h"

using namespace kelvo;
using namespace kelvo::adaptation;

constexpr auto kFixed = fixedLayout(4, {{"PCI", 0, u16}, {"RSRP", 2, u16, steps(1, 4, -140)}});
constexpr auto kNewer = newerLayout(kFixed, 4, {{"PCI", 0, u16}, {"RSRP", 2, u16}});
