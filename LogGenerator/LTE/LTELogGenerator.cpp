#include "LogGenerator/LTE/LTELogGenerator.h"

#include "LogGenerator/LTE/LTEClassIndex.h"
#include "platform/system/Environment.h"

namespace kelvo {

namespace {
std::unique_ptr<ClassIndex> announcedClassIndex() {
    logLine(Level::Error, "Creating LTELogGenerator object");
    return std::make_unique<LTEClassIndex>();
}
}  // namespace

LTELogGenerator::LTELogGenerator() : OSKLogGenerator2("LTE", announcedClassIndex()) {}

LTELogGenerator::~LTELogGenerator() {
    logLine(Level::Warning, "LTELogGenerator is destructed %p", static_cast<const void*>(this));
}

}  // namespace kelvo
