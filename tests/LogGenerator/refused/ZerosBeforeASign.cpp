// refused: throw "leading zeros are supported for %x only"
#include "LogGenerator/LTE/LTECodes.h"
#include "LogGenerator/ShowFields.h"

using namespace kelvo;

constexpr auto kCell = entry(2, {{0, i16, "Level", whole(1, 0, dBm, "%04d")}});
