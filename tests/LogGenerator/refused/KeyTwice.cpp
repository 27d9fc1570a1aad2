// refused: throw "a key is used twice"
#include "LogGenerator/LTE/LTECodes.h"
#include "LogGenerator/ShowFields.h"

using namespace kelvo;

constexpr auto kCell = entry(6, {{0, u16, "PCI", decimal}, {2, u16, "RSRP", decimal}, {4, u16, "PCI", decimal}});
