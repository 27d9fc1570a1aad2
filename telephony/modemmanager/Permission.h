#pragma once

#include <optional>
#include <string>
#include <string_view>

namespace kelvo::modemmanager {

/// The right that this user lacks, for people, when ModemManager or its bus refused `method` with the error called
/// `error`; none when the reason is another.
std::optional<std::string> missingRight(std::string_view method, std::string_view error);

}  // namespace kelvo::modemmanager
