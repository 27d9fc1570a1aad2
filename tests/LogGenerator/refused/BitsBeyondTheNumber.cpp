// refused: throw "the bits lie beyond the number"
#include "LogGenerator/LTE/LTECodes.h"
#include "LogGenerator/ShowFields.h"

using namespace kelvo;

constexpr auto kCell = entry(4, {{0, u16.bits(9, 16), "Layer Priority", decimal}});
