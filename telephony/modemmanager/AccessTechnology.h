#pragma once

#include <cstdint>
#include <optional>
#include <string>

#include "platform/telephony/Technology.h"
#include "telephony/phone/PhonePayloads.h"

namespace kelvo::modemmanager {

/// A set of ModemManager's MMModemAccessTechnology bits: what a phone is on.
struct AccessTechnology {
    std::uint32_t bits = 0;

    /// Every technology by its name, "GSM, EDGE"; empty when none is known.
    std::string words() const;
    /// Whose screens show it; none for 5G alone, and when none is known.
    std::optional<Technology> family() const;
    /// What its serving cell is; none where the cell array has no such cells.
    std::optional<phone::MonitoredCell::Technology> cell() const;
};

}  // namespace kelvo::modemmanager
