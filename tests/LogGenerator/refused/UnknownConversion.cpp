// refused: throw "this conversion is not supported"
#include "LogGenerator/LTE/LTECodes.h"
#include "LogGenerator/ShowFields.h"

using namespace kelvo;

constexpr auto kCell = entry(2, {{0, u16, "Level", linear(0.25, -140.0, "%e", dBm)}});
