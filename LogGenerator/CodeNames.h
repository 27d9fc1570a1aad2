#pragma once

#include <fmt/format.h>

#include <span>
#include <string>

#include "LogGenerator/CDMA/CDMACodes.h"
#include "LogGenerator/GSMUMTS/GSMUMTSCodes.h"
#include "LogGenerator/LTE/LTECodes.h"
#include "LogGenerator/PhoneServices/PhoneCodes.h"
#include "LogGenerator/UTRAN/UTRANCodes.h"

/// Names of log codes for people. Inline functions alone: whoever includes this links no decoder.
namespace kelvo {

/// The families' entry for a code; null when none of them names it.
constexpr const KnownCode* knownCode(LogCode code) {
    const std::span<const KnownCode> families[] = {code::kCDMA, code::kGSMUMTS, code::kLTE, code::kPhoneServices,
                                                   code::kUTRAN};
    for (const std::span<const KnownCode> family : families) {
        for (const KnownCode& known : family) {
            if (known.code == code) return &known;
        }
    }
    return nullptr;
}

/// "LTE serving cell, idle"; empty for a code without a name.
inline std::string nameOfCode(LogCode code) {
    if (const KnownCode* known = knownCode(code)) return std::string(known->name);
    const KnownCode* single = code >> 12 == 5 ? knownCode(code - code::kDualSimOffset) : nullptr;
    return single != nullptr ? std::string(single->name) + ", dual SIM" : std::string();
}

/// A code as every message writes it: "0xb17f  LTE serving cell, idle", or the number alone.
inline std::string describeCode(LogCode code) {
    const std::string name = nameOfCode(code);
    return fmt::format("0x{:04x}{}{}", code, name.empty() ? "" : "  ", name);
}

}  // namespace kelvo
