#include "LogGenerator/OSKLogGenerator.h"

#include <fmt/printf.h>

#include <utility>

#include "LogGenerator/SnapshotFormat.h"
#include "platform/system/Environment.h"

namespace kelvo {

namespace {

constexpr const char* kBuildDate = "Mar  7 2019 22:35:20";  // a fixed mark of the file format, not of this build

std::string versionText() {
    const std::string_view version = Environment::current().version;
    return version.empty() ? "(none)" : "Kelvo " + std::string(version);
}

DLFTimeRecord currentTime() {
    const Clock::TimePoint now = clock().now();
    const std::tm local = clock().local(now);
    return {.seconds = static_cast<std::uint32_t>(std::chrono::system_clock::to_time_t(now)),
            .zoneMinutes = static_cast<std::int16_t>(local.tm_gmtoff / 60),
            .daylight = static_cast<std::uint8_t>(local.tm_isdst > 0 ? 1 : 0)};
}

}  // namespace

std::optional<Bytes> OSKLogGenerator::generateDlfFromState(const Dictionary& state, std::size_t reportSize) {
    Bytes dlf(reportSize);
    std::size_t written = 0;
    const DLFStatus result = DLFAddVersionReport(dlf.data(), dlf.size(), written, 1, 1, versionText(),
                                                 "EXECUTABLE_NAME", kBuildDate, currentTime());
    if (result != kDLFSuccess) {
        logLine(Level::DlfWriter, "Could not write DLF header (result=%d)", static_cast<int>(result));
        return std::nullopt;
    }

    const ArrayRef& history = state["History"].array();
    for (std::size_t i = 0; history && i < history->size(); ++i) {
        const DictionaryRef& taken = (*history)[i].dictionary();
        if (!taken || !(*taken)[snapshot::kDisplayState]) continue;
        const Bytes* raw = (*taken)[snapshot::kDisplayState].data();
        if (raw == nullptr) {
            logLine(Level::DlfWriter, "Got wrong class writing history to DLF; aborting writing the DLF file");
            return std::nullopt;
        }
        // Intended: a snapshot loses its first byte alone, not the type byte of every packet in it.
        if (raw->size() >= 2) dlf.insert(dlf.end(), raw->begin() + 1, raw->end());
    }
    return dlf;
}

ArrayRef OSKLogGenerator::getSaveContentsFromState(Dictionary& state) {
    const ArrayRef& history = state["History"].array();
    const ArrayRef contents = history ? std::make_shared<Array>(*history) : Array::make();
    if (std::optional<Bytes> dlf = generateDlfFromState(state)) {
        const std::string description = fmt::sprintf("DLF binary (%d bytes)", dlf->size());
        contents->append(Dictionary::make({{snapshot::kDescription, description}, {snapshot::kDLF, std::move(*dlf)}}));
    }
    return contents;
}

void OSKLogGenerator::limitRawLog(std::size_t bytes) {
    _rawLogLimit = bytes;
    if (_binData.size() > bytes) _binData = Bytes();
}

void OSKLogGenerator::keepRaw(ByteView record) {
    const std::size_t room = _rawLogLimit - _binData.size();
    if (record.size() > room) {
        ++_notKept;
        return;
    }
    _binData.insert(_binData.end(), record.begin(), record.end());
}

void OSKLogGenerator::moveBinDataInto(Dictionary& state) {
    if (_notKept > 0) logLine(Level::Error, "The raw log was full: it lacks %d records", std::exchange(_notKept, 0));
    state.set("DisplayState", std::move(_binData));
    _binData = Bytes();
}

}  // namespace kelvo
