#include "ui/PlatformStart.h"

#include <fmt/format.h>

#include <QStringList>
#include <cstdio>
#include <cstdlib>
#include <mutex>

namespace kelvo {
namespace {

std::mutex guard;
QStringList reasons;  // warnings, bare
QStringList lines;    // all that was said, as it is shown
QtMessageHandler before = nullptr;

void keepBack(QtMsgType type, const QMessageLogContext& context, const QString& text) {
    if (type == QtFatalMsg) PlatformStart::fail(text);
    const std::lock_guard lock(guard);
    if (type == QtWarningMsg || type == QtCriticalMsg) reasons.append(text.simplified());
    lines.append(qFormatLogMessage(type, context, text));
}

}  // namespace

PlatformStart::PlatformStart() { before = qInstallMessageHandler(keepBack); }

PlatformStart::~PlatformStart() {
    qInstallMessageHandler(before);
    const std::lock_guard lock(guard);
    for (const QString& line : std::as_const(lines)) fmt::print(stderr, "{}\n", line.toStdString());
    reasons.clear();
    lines.clear();
}

void PlatformStart::fail(const QString& reason) {
    const std::lock_guard lock(guard);
    const QString told = reasons.isEmpty() ? reason.simplified() : reasons.join(QStringLiteral("; "));
    fmt::print(stderr, "kelvo: no window can be opened: {}\n", told.toStdString());
    std::fflush(stderr);
    std::_Exit(EXIT_FAILURE);  // as the abort would, but for the status: a half-started platform cannot be taken down
}

}  // namespace kelvo
