// refused: throw "a field lies past the end"
#include "LogGenerator/LTE/LTECodes.h"
#include "LogGenerator/ShowFields.h"

using namespace kelvo;

constexpr auto kCell = entry(5, {{0, u16, "PCI", decimal}, {2, u32, "Cell Identity", asSigned}});
