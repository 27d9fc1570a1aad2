#include "LogGenerator/GSMUMTS/OSK_GSMClassIndex.h"

#include "platform/system/Environment.h"

namespace kelvo {

OSK_GSMClassIndex::~OSK_GSMClassIndex() { printLine("Deallocing OSK_GSMClassIndex"); }

}  // namespace kelvo
