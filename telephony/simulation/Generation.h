#pragma once

#include <cstdint>
#include <string_view>

#include "platform/telephony/Technology.h"
#include "platform/values/Result.h"

namespace kelvo::simulation {

/// The year of a played modem: newer ones word the same reports in newer layouts, and send new codes in place of old
/// ones. The drive is the same. `Of2010` is the generation whose layouts Kelvo's screens read.
enum class Generation : std::uint8_t { Of2010, Of2014, Of2018 };

/// The generation of a year, as on a command line. Only LTE and GSM/UMTS records have changed with the years; the
/// reason of a failure says so, or which years there are.
Result<Generation> generationOf(Technology technology, std::string_view year);

/// "2014".
std::string_view yearOf(Generation generation);

}  // namespace kelvo::simulation
