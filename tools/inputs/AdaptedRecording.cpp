#include "tools/inputs/AdaptedRecording.h"

#include <fmt/format.h>

#include <utility>

#include "LogGenerator/Framing.h"

namespace kelvo {

using adaptation::Adapted;

AdaptedRecording::AdaptedRecording(std::string path, ImportedFile file, Technology technology,
                                   const RecordSurvey& survey)
    : _path(std::move(path)),
      _file(std::move(file)),
      _codes(FamilyCodes::of(technology)),
      _subscription(survey.subscription()),
      _clock(survey.first()) {}

Result<std::optional<CapturePacket>> AdaptedRecording::next() {
    for (;;) {
        const auto message = _file.reader->next();
        if (!message) return message.error();
        if (!*message) break;
        const CaptureTime time = _clock.timeOf(**message);
        if (const auto bytes = taken(**message)) {
            ++_given;
            return std::optional(CapturePacket{time, *bytes});
        }
    }
    if (_file.reader->damage().isCut) return Failure{fmt::format("{} breaks off after record {}", _path, _given)};
    return std::optional<CapturePacket>();
}

/// The record in the layout that is shown; none for one that is not asked for or cannot be shown.
std::optional<ByteView> AdaptedRecording::taken(const RecordedMessage& message) {
    if (message.subscription && _subscription && *message.subscription != *_subscription) return std::nullopt;
    const Adapted adapted = _adapter->adapt(stripPrefix(message.message));
    if (adapted.outcome == Adapted::Outcome::Refused) {
        if (adapted.refusal != adaptation::Refusal::NotOurs) ++_refused;
        return std::nullopt;
    }
    if (!_codes.include(adapted.packet)) return std::nullopt;
    return adapted.outcome == Adapted::Outcome::Turned ? adapted.packet : message.message;
}

std::vector<std::string> AdaptedRecording::leftOut() const {
    std::vector<std::string> lines = damageOf(_path, _file);
    if (_refused != 0) {
        lines.push_back(
            fmt::format("{}: {} records are in layouts that cannot be shown; kelvoctl import --list tells "
                        "which",
                        _path, _refused));
    }
    return lines;
}

}  // namespace kelvo
