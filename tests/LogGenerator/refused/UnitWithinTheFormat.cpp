// refused: throw "a format has one conversion"
#include "LogGenerator/LTE/LTECodes.h"
#include "LogGenerator/ShowFields.h"

using namespace kelvo;

constexpr ShownReal kErrorRate("%.2f%%", percent);
