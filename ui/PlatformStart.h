#pragma once

#include <QString>

namespace kelvo {

/// The start of the window system's side of Qt, while it lives. Where that cannot start, Qt tells so in several lines
/// and aborts; this ends the program with one line on standard error and exit status 1. What Qt has to say meanwhile,
/// from whatever thread, is kept back, and comes when the start is over. One at a time.
class PlatformStart {
public:
    PlatformStart();
    ~PlatformStart();
    PlatformStart(const PlatformStart&) = delete;
    PlatformStart& operator=(const PlatformStart&) = delete;

    /// Ends the program: no window can be opened, for the reasons that were kept back, or `reason` when there are none.
    [[noreturn]] static void fail(const QString& reason);
};

}  // namespace kelvo
