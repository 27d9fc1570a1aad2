#include "LogGenerator/UTRAN/UTRANClassIndex.h"

#include "platform/system/Environment.h"

namespace kelvo {

UTRANClassIndex::~UTRANClassIndex() { printLine("Deallocing UTRANClassIndex"); }

}  // namespace kelvo
