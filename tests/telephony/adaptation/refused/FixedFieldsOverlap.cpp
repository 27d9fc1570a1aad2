// refused: throw "two fields share a bit"
#include "telephony/adaptation/LayoutWords.h"

using namespace kelvo;
using namespace kelvo::adaptation;

constexpr auto kFixed = fixedLayout(2, {{"PCI", 0, u16.bits(0, 9)}, {"layer priority", 0, u16.bits(9, 12)}});
