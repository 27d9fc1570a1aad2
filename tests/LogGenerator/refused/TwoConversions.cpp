// refused: throw "a format has one conversion"
#include "LogGenerator/LTE/LTECodes.h"
#include "LogGenerator/ShowFields.h"

using namespace kelvo;

constexpr ValueTable kStates({{0, "Idle"}}, "state %d of %d");
