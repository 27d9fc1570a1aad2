#pragma once

#include <memory>
#include <string_view>

#include "LogGenerator/LogGenerator.h"

namespace kelvo {

/// The generator of a technology, by one of the kPLLogChannelTechnology_ identifiers; none for any other text. It knows
/// every family, which the base class must not, and so stands beside it.
std::unique_ptr<LogGenerator> generatorFromTechnology(std::string_view technology);

}  // namespace kelvo
