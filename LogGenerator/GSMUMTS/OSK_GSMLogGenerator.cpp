#include "LogGenerator/GSMUMTS/OSK_GSMLogGenerator.h"

#include "LogGenerator/GSMUMTS/OSK_GSMClassIndex.h"
#include "platform/system/Environment.h"

namespace kelvo {

namespace {
std::unique_ptr<ClassIndex> announcedClassIndex() {
    logLine(Level::Error, "Creating OSK_GSMLogGenerator object");
    return std::make_unique<OSK_GSMClassIndex>();
}
}  // namespace

OSK_GSMLogGenerator::OSK_GSMLogGenerator() : OSKLogGenerator2("OSK_GSM", announcedClassIndex()) {}

OSK_GSMLogGenerator::~OSK_GSMLogGenerator() {
    logLine(Level::Warning, "OSK_GSMLogGenerator is destructed %p", static_cast<const void*>(this));
}

}  // namespace kelvo
