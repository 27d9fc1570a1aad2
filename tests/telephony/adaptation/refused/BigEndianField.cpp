// refused: throw "a field is no little-endian number"
#include "telephony/adaptation/LayoutWords.h"

using namespace kelvo;
using namespace kelvo::adaptation;

constexpr auto kFixed = fixedLayout(4, {{"PCI", 0, u16.bigEndian()}, {"RSRP", 2, u16, steps(1, 4, -140)}});
