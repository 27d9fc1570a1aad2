#include "LogGenerator/ClassIndex.h"

#include "platform/system/Environment.h"

namespace kelvo {

ClassIndex::~ClassIndex() { printLine("Deallocing ClassIndex"); }

Base* ClassIndex::getClass(std::string_view name) const {
    const auto at = classDict.find(name);
    return at != classDict.end() ? at->second : nullptr;
}

void ClassIndex::status() const {
    logLine(Level::Warning, "Dictionary = %d", 1);
    logLine(Level::Warning, "String = %d", 0);
}

std::vector<std::string_view> ClassIndex::getAllNames() const {
    std::vector<std::string_view> names;
    for (const auto& [name, section] : classDict) names.emplace_back(name);
    return names;
}

}  // namespace kelvo
