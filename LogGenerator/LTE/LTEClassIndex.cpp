#include "LogGenerator/LTE/LTEClassIndex.h"

#include "platform/Environment.h"

namespace kelvo {

LTEClassIndex::~LTEClassIndex() { printLine("Deallocing LTEClassIndex"); }

}  // namespace kelvo
