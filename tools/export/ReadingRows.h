#pragma once

#include <cstdint>
#include <optional>
#include <span>
#include <string>

#include "tools/export/Moment.h"
#include "tools/export/Series.h"

namespace kelvo {

/// An input that was read, whole or as far as it goes.
struct ReadInput {
    std::size_t number = 0;  ///< which of them, from 0
    std::string name{};
    Technology technology{};
    std::uint64_t records = 0;
    std::optional<CaptureTime> first{};
    std::optional<CaptureTime> last{};
    std::string breakOff{};  ///< where and why it goes no further; empty at its end
};

/// Where readings go: a form of output. What cannot be written ends the command (CommandFailure).
class ReadingRows {
public:
    virtual ~ReadingRows() = default;

    /// Writes what one record has written, or what stands in one line.
    virtual void write(const Moment& moment, std::span<const Written> readings) = 0;
    /// All series that were handed over so far go after this.
    virtual void letSeriesGo() {}
    /// Tells what was read, behind the last reading of each input.
    virtual void endInput(const ReadInput& /*input*/) {}
    /// The rest: after it the output is whole. Called once, also when reading ended early.
    virtual void finish() = 0;
};

}  // namespace kelvo
