#include "LogGenerator/UTRAN/UTRANLogGenerator.h"

#include <algorithm>
#include <filesystem>

#include "LogGenerator/UTRAN/UTRANClassIndex.h"
#include "platform/system/Environment.h"

namespace kelvo {

namespace {

bool mentionsUtran(std::string_view name) {
    constexpr std::string_view kName = "utran";
    const auto sameLetter = [](char a, char b) { return (a >= 'A' && a <= 'Z' ? a - 'A' + 'a' : a) == b; };
    return std::search(name.begin(), name.end(), kName.begin(), kName.end(), sameLetter) != name.end();
}

std::optional<std::string> findTemplate() {
    const Resources* resources = Environment::current().resources;
    if (resources == nullptr) return std::nullopt;
    for (const std::string& path : resources->pathsOfType("plist")) {
        // The name alone: where the program is installed says nothing about its templates.
        std::string name = std::filesystem::path(path).stem().string();
        if (mentionsUtran(name)) return name;
    }
    return std::nullopt;
}

}  // namespace

UTRANLogGenerator::UTRANLogGenerator() : UTRANLogGenerator(findTemplate()) {}

UTRANLogGenerator::UTRANLogGenerator(const std::optional<std::string>& templateName)
    : OSKLogGenerator2(templateName.value_or(""), templateName ? std::make_unique<UTRANClassIndex>() : nullptr) {
    if (templateName) logLine(Level::Error, "Created UTRANLogGenerator object");
}

}  // namespace kelvo
