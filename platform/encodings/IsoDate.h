#pragma once

#include <optional>
#include <string>
#include <string_view>

#include "platform/values/Value.h"

namespace kelvo {

/// Whether `date` lies in the years 0 to 9999, which is what the written form can carry.
bool hasIsoForm(Date date);

/// `date` in ISO 8601, UTC, down to the second: "2011-03-04T09:15:02Z". Requires `hasIsoForm(date)`.
std::string isoDate(Date date);

/// The date that `text`, in exactly that form, stands for; none for another form or a day that does not exist.
std::optional<Date> dateFromIso(std::string_view text);

}  // namespace kelvo
