#include "LogGenerator/LTE/LTEClassIndex.h"

#include "platform/system/Environment.h"

namespace kelvo {

LTEClassIndex::~LTEClassIndex() { printLine("Deallocing LTEClassIndex"); }

}  // namespace kelvo
