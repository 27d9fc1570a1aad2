#include "LogGenerator/UTRAN/UTRANClassIndex.h"

#include "platform/Environment.h"

namespace kelvo {

UTRANClassIndex::~UTRANClassIndex() { printLine("Deallocing UTRANClassIndex"); }

}  // namespace kelvo
