#pragma once

#include <filesystem>

#include "platform/system/Resources.h"

namespace kelvo {

/// Resources that lie as files in one directory. Listings are sorted by file name.
class DirectoryResources final : public Resources {
public:
    explicit DirectoryResources(std::filesystem::path directory) : _directory(std::move(directory)) {}

    Result<DictionaryRef> dictionary(std::string_view name) const override;
    std::vector<std::string> pathsOfType(std::string_view type) const override;

private:
    std::filesystem::path _directory;
};

}  // namespace kelvo
