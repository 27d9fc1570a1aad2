// refused: deleted function
#include "LogGenerator/LTE/LTECodes.h"
#include "LogGenerator/ShowFields.h"

using namespace kelvo;

void show(Value& value) { showValue(value, 7, whole(1, 0, dBm)); }
