// refused: throw "32 bits must say whether they are signed"
#include "LogGenerator/LTE/LTECodes.h"
#include "LogGenerator/ShowFields.h"

using namespace kelvo;

constexpr auto kCell = entry(4, {{0, u32, "Cell Identity", decimal}});
