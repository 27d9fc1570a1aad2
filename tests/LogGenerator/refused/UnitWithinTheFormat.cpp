// refused: throw "one conversion a format"
#include "LogGenerator/LTE/LTECodes.h"
#include "LogGenerator/ShowFields.h"

using namespace kelvo;

constexpr ShownReal kErrorRate("%.2f%%", percent);
