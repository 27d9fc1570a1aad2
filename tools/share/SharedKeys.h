#pragma once

#include <optional>
#include <span>
#include <string_view>

#include "tools/share/Identity.h"

namespace kelvo {

/// A key as screens and cell monitors write it, and whom its values name.
struct SharedKey {
    std::string_view section;  ///< the screen or list in which the key means this; empty: wherever it stands
    std::string_view key;
    Identity identity;
};

/// What Kelvo knows to be on a screen or in a cell monitor's tree.
std::span<const SharedKey> sharedKeys();

/// Whom the values under `key` in `section` name; none for a key that nobody knows. A number and a semicolon in front
/// of either, by which screens are sorted, are no part of it.
std::optional<Identity> identityOf(std::string_view section, std::string_view key);

/// Whether `name` is that of a screen, a list or a part of a cell monitor's tree.
bool isScreen(std::string_view name);

/// "UMTS Cells" of "02;UMTS Cells".
std::string_view withoutOrder(std::string_view name);

}  // namespace kelvo
