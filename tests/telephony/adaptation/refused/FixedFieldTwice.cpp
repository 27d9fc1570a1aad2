// refused: throw "a name stands twice"
#include "telephony/adaptation/LayoutWords.h"

using namespace kelvo;
using namespace kelvo::adaptation;

constexpr auto kFixed = fixedLayout(4, {{"PCI", 0, u16}, {"PCI", 2, u16}});
