#pragma once

#include <string>

#include "platform/values/Dictionary.h"
#include "telephony/phone/PhoneService.h"

namespace kelvo {

/// What a service of the phone's system knows, as the status has it. Identities are shortened.
DictionaryRef phoneStatus(const phone::PhoneService& service);
/// The same for people.
std::string phoneStatusText(const Dictionary& phone);

}  // namespace kelvo
