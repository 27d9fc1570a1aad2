#pragma once

#include <string>
#include <utility>
#include <vector>

#include "platform/system/SystemLog.h"

namespace kelvo::test {

/// Keeps every line with its level.
class RecordingLog final : public SystemLog {
public:
    using Line = std::pair<int, std::string>;

    bool wants(Level) const override { return true; }
    void write(Level level, std::string_view text) override { _lines.emplace_back(static_cast<int>(level), text); }

    const std::vector<Line>& lines() const { return _lines; }
    void clear() { _lines.clear(); }

private:
    std::vector<Line> _lines;
};

}  // namespace kelvo::test
