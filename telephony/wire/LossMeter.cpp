#include "telephony/wire/LossMeter.h"

#include <fmt/format.h>

#include <utility>

namespace kelvo::wire {
namespace {

using namespace std::chrono_literals;

constexpr auto kQuiet = 5s;

// "3 bad checksums, 1 lying length": what was lost between two counts.
std::string difference(const PortCounts& before, const PortCounts& after) {
    std::string text;
    const auto tell = [&text](std::uint64_t from, std::uint64_t to, const char* one, const char* several) {
        if (to == from) return;
        text += fmt::format("{}{} {}", text.empty() ? "" : ", ", to - from, to - from == 1 ? one : several);
    };
    tell(before.frames.badChecksums, after.frames.badChecksums, "bad checksum", "bad checksums");
    tell(before.frames.badEscapes, after.frames.badEscapes, "bad escape", "bad escapes");
    tell(before.frames.tooShort, after.frames.tooShort, "frame too short", "frames too short");
    tell(before.frames.oversized, after.frames.oversized, "oversized frame", "oversized frames");
    tell(before.frames.unfinished, after.frames.unfinished, "unfinished frame", "unfinished frames");
    tell(before.lyingLengths, after.lyingLengths, "lying length", "lying lengths");
    tell(before.strange, after.strange, "strange wrapper", "strange wrappers");
    tell(before.textsDropped, after.textsDropped, "text dropped by the modem", "texts dropped by the modem");
    return text;
}

// What of the modem's is lost: texts are no records.
const char* lost(const PortCounts& before, const PortCounts& after) {
    return after.damaged() == before.damaged() ? "loses texts" : "loses records";
}

}  // namespace

std::optional<std::string> LossMeter::update(const PortCounts& counts, nanoseconds now) {
    const std::uint64_t loss = lossOf(counts);
    if (loss != _last) {
        _last = loss;
        _lastLoss = now;
        if (!std::exchange(_losing, true))
            return fmt::format("{}: {}", lost(_before, counts), difference(_before, counts));
    } else if (now - _lastLoss >= kQuiet) {
        return finish(counts);
    }
    if (!_losing) _before = counts;
    return std::nullopt;
}

std::optional<std::string> LossMeter::finish(const PortCounts& counts) {
    const PortCounts before = std::exchange(_before, counts);
    if (!std::exchange(_losing, false)) return std::nullopt;
    return fmt::format("no longer {}; it was {}", lost(before, counts), difference(before, counts));
}

std::optional<std::chrono::nanoseconds> LossMeter::deadline() const {
    return _losing ? std::optional(_lastLoss + kQuiet) : std::nullopt;
}

}  // namespace kelvo::wire
