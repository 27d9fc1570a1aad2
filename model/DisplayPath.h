#pragma once

#include <string>
#include <string_view>

namespace kelvo {

/// Extends `path` by `name` as a path component: "/" and "A" give "/A", "/A" and "B" give "/A/B". No separator is
/// doubled where the two meet, and an empty name leaves the path as it is.
void appendToPath(std::string& path, std::string_view name);

/// `parent` extended by `name`.
std::string pathByAppending(std::string_view parent, std::string_view name);

/// "02;RSCP" is shown as "RSCP" and ordered by its prefix; a key with no or with several ";" is its own name.
std::string_view nameOfSortedKey(std::string_view key);

}  // namespace kelvo
