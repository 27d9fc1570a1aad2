#include "ui/DateFormatter.h"

#include <QDateTime>

#include "platform/system/Environment.h"

namespace kelvo {

QString DateFormatter::stringFromDate(Clock::TimePoint time) const {
    const std::tm at = clock().local(time);
    // UTC here only keeps Qt from moving what the clock has already made local.
    const QDateTime local(QDate(at.tm_year + 1900, at.tm_mon + 1, at.tm_mday), QTime(at.tm_hour, at.tm_min, at.tm_sec),
                          Qt::UTC);
    return local.toString(_format);
}

}  // namespace kelvo
