#pragma once

#include <functional>
#include <string>
#include <vector>

#include "LogGenerator/LogCode.h"
#include "platform/telephony/Technology.h"
#include "telephony/wire/RecordConfiguration.h"

namespace kelvo {

/// Which screens of a family a modem, or a recording, can fill.
struct FillableScreens {
    Technology technology{};
    std::vector<std::string> filled;  ///< there is every record of theirs
    std::vector<std::string> partly;  ///< there are some
    std::vector<std::string> empty;   ///< there is none
    std::vector<std::string> phone;   ///< their records are not the modem's: they come from the phone's own services
};

/// The families whose records come by a diagnostic port, by which codes there are.
std::vector<FillableScreens> fillableScreens(const std::function<bool(LogCode)>& has);
/// The same, those of the phone's own services among the codes.
std::vector<FillableScreens> screensWithServices(const std::function<bool(LogCode)>& has);
/// The same by what a modem can send.
std::vector<FillableScreens> fillableScreens(const wire::Ranges& ranges);

}  // namespace kelvo
