#pragma once

#include <nlohmann/json.hpp>
#include <string>
#include <vector>

#include "telephony/phone/PhoneState.h"

namespace kelvo {

/// What ModemManager knows of one modem.
struct ModemFindings {
    phone::PhoneState phone{};
    std::vector<std::string> lacks{};  ///< what it refuses of this one
};

/// What ModemManager knows of the phone.
struct PhoneFindings {
    std::string trouble{};                ///< why there is nothing of the first modem, or less than there may be
    std::vector<ModemFindings> modems{};  ///< the first first
};

/// The findings for people; identities are shortened.
std::string phoneFindingsText(const PhoneFindings& findings);
/// The same for programs.
nlohmann::ordered_json phoneFindingsJson(const PhoneFindings& findings);

}  // namespace kelvo
