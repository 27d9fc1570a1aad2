#include "platform/system/DirectoryResources.h"

#include <fmt/format.h>

#include <algorithm>
#include <fstream>

#include "platform/encodings/PropertyList.h"

namespace kelvo {

Result<DictionaryRef> DirectoryResources::dictionary(std::string_view name) const {
    const std::filesystem::path path = _directory / (std::string(name) + ".plist");
    std::error_code missing;
    const auto size = std::filesystem::file_size(path, missing);
    std::ifstream file(path, std::ios::binary);
    if (missing || !file) return Failure{"no resource " + path.string()};
    Bytes bytes(size);
    if (!file.read(reinterpret_cast<char*>(bytes.data()), static_cast<std::streamsize>(size))) {
        return Failure{path.string() + ": cannot be read"};
    }
    Result<Value> value = readPropertyList(bytes);
    if (!value) return Failure{path.string() + ": " + value.error().reason};
    if (!value->dictionary()) return Failure{path.string() + ": not a dictionary"};
    return value->dictionary();
}

std::vector<std::string> DirectoryResources::pathsOfType(std::string_view type) const {
    std::vector<std::string> paths;
    std::error_code unreadable;  // a missing directory holds nothing
    for (const auto& entry : std::filesystem::directory_iterator(_directory, unreadable)) {
        if (entry.path().extension() == fmt::format(".{}", type)) paths.push_back(entry.path().string());
    }
    std::sort(paths.begin(), paths.end());
    return paths;
}

}  // namespace kelvo
