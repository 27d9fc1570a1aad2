// refused: throw "a format that is not printed here"
#include "LogGenerator/LTE/LTECodes.h"
#include "LogGenerator/ShowFields.h"

using namespace kelvo;

constexpr auto kCell = entry(2, {{0, u16, "Level", linear(0.25, -140.0, "%e", dBm)}});
