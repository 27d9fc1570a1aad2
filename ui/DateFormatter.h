#pragma once

#include <QString>

#include "platform/system/Clock.h"

namespace kelvo {

/// Formats moments in the clock's local zone. In the format, quoted words stand as they are.
class DateFormatter {
public:
    explicit DateFormatter(QString format) : _format(std::move(format)) {}
    QString stringFromDate(Clock::TimePoint time) const;

private:
    QString _format;
};

}  // namespace kelvo
