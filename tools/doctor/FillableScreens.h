#pragma once

#include <string>
#include <vector>

#include "platform/telephony/Technology.h"
#include "telephony/wire/RecordConfiguration.h"

namespace kelvo {

/// Which screens of a family a modem can fill.
struct FillableScreens {
    Technology technology{};
    std::vector<std::string> filled;  ///< it has every record of theirs
    std::vector<std::string> partly;  ///< it has some
    std::vector<std::string> empty;   ///< it has none
    std::vector<std::string> phone;   ///< their records are not the modem's: they come from the phone's own services
};

/// The families whose records come by a diagnostic port, by what a modem has.
std::vector<FillableScreens> fillableScreens(const wire::Ranges& ranges);

}  // namespace kelvo
