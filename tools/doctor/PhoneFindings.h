#pragma once

#include <nlohmann/json.hpp>
#include <string>
#include <vector>

#include "telephony/phone/PhoneState.h"

namespace kelvo {

/// What ModemManager knows of the phone.
struct PhoneFindings {
    std::string trouble{};                    ///< why there is nothing, or less than there may be
    std::vector<phone::PhoneState> modems{};  ///< the first first; the others without SIM, cells and data contexts
    std::vector<std::string> lacks{};         ///< what it refuses of the first
};

/// The findings for people; identities are shortened.
std::string phoneFindingsText(const PhoneFindings& findings);
/// The same for programs.
nlohmann::ordered_json phoneFindingsJson(const PhoneFindings& findings);

}  // namespace kelvo
