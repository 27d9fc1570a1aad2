#pragma once

#include <set>
#include <string>
#include <string_view>

#include "platform/system/SystemLog.h"

namespace kelvo {

/// A log that tells of a failed start once. The monitor tries again every five seconds and fails with the same words;
/// why there is no connection stands on the screen meanwhile.
class RetryLog final : public SystemLog {
public:
    /// `log` outlives it.
    explicit RetryLog(SystemLog& log) : _log(log) {}

    bool wants(Level level) const override { return _log.wants(level); }
    void write(Level level, std::string_view text) override {
        if (_connected || _told.emplace(text).second) _log.write(level, text);
    }
    /// While connected every line passes.
    void setConnected(bool connected) {
        if (connected != _connected) _told.clear();
        _connected = connected;
    }

private:
    SystemLog& _log;
    bool _connected = false;
    std::set<std::string> _told;  // since the connection was lost
};

}  // namespace kelvo
