#include "model/DisplayPath.h"

#include <algorithm>

namespace kelvo {

void appendToPath(std::string& path, std::string_view name) {
    name.remove_prefix(std::min(name.find_first_not_of('/'), name.size()));
    if (name.empty()) return;
    if (!path.ends_with('/')) path += '/';
    path += name;
}

std::string pathByAppending(std::string_view parent, std::string_view name) {
    std::string path(parent);
    appendToPath(path, name);
    return path;
}

std::string_view nameOfSortedKey(std::string_view key) {
    const std::size_t separator = key.find(';');
    const bool twoParts = separator != key.npos && key.find(';', separator + 1) == key.npos;
    return twoParts ? key.substr(separator + 1) : key;
}

}  // namespace kelvo
