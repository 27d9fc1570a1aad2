// refused: throw "a newer layout names each field of the fixed one once"
#include "telephony/adaptation/LayoutWords.h"

using namespace kelvo;
using namespace kelvo::adaptation;

constexpr auto kFixed = fixedLayout(4, {{"PCI", 0, u16}, {"RSRP", 2, u16, steps(1, 4, -140)}});
constexpr auto kNewer = newerLayout(kFixed, 4, {{"PCI", 0, u16}});
