#include "tools/inputs/Input.h"

#include <fmt/format.h>
#include <sys/stat.h>
#include <unistd.h>

#include <algorithm>
#include <array>
#include <cerrno>
#include <cstdio>
#include <filesystem>
#include <fstream>
#include <map>
#include <system_error>
#include <utility>

#include "LogGenerator/Framing.h"
#include "telephony/recordings/RecordingFile.h"
#include "tools/ReadSnapshot.h"
#include "tools/SnapshotCapture.h"
#include "tools/inputs/AdaptedRecording.h"

namespace kelvo {

namespace {

constexpr const char* kStandardInput = "-";

/// A capture's packets are records as they stand.
class CaptureRecords final : public InputRecords {
public:
    /// `size`: of the file, where it lies there as it is read.
    CaptureRecords(CaptureReader reader, std::optional<std::uint64_t> size) : _reader(std::move(reader)), _size(size) {}
    Result<std::optional<CapturePacket>> next() override {
        auto packet = _reader.next();
        if (packet && *packet) _read += kPacketHeader + (*packet)->bytes.size();
        return packet;
    }
    std::optional<double> portion() const override {
        if (!_size) return std::nullopt;
        return std::min(1.0, static_cast<double>(_read) / static_cast<double>(*_size));
    }

private:
    static constexpr std::uint64_t kFileHeader = 24;
    static constexpr std::uint64_t kPacketHeader = 16;
    CaptureReader _reader;
    std::optional<std::uint64_t> _size;
    std::uint64_t _read = kFileHeader;
};

/// A snapshot's history. It holds what the service has delivered, as a capture does.
class SnapshotRecords final : public InputRecords {
public:
    SnapshotRecords(std::vector<SnapshotMessage> messages, std::vector<std::string> odd)
        : _messages(std::move(messages)), _odd(std::move(odd)) {}

    Result<std::optional<CapturePacket>> next() override {
        if (_next == _messages.size()) return std::optional<CapturePacket>();
        const SnapshotMessage& message = _messages[_next++];
        return std::optional(CapturePacket{message.time, message.bytes});
    }
    std::vector<std::string> leftOut() const override { return _odd; }

private:
    std::vector<SnapshotMessage> _messages;
    std::size_t _next = 0;
    std::vector<std::string> _odd;
};

/// The family that most of the messages can only be of; none when there is no such message.
std::optional<Technology> technologyOf(const std::vector<SnapshotMessage>& messages) {
    const RecordSurvey families;
    std::map<Technology, std::size_t> counts;
    for (const SnapshotMessage& message : messages) {
        const auto technology = families.technologyOf(stripPrefix(message.bytes));
        if (technology) ++counts[*technology];
    }
    const auto most = std::ranges::max_element(counts, {}, [](const auto& count) { return count.second; });
    return most != counts.end() ? std::optional(most->first) : std::nullopt;
}

Failure nothingToShow(const std::string& path) {
    return {path + " holds no record that can be shown; kelvoctl import --list tells what it holds"};
}

Result<CaptureReader> captureFromStandardInput() {
    const std::string name = "standard input";
    if (::isatty(STDIN_FILENO) != 0) return Failure{name + " is a terminal; - takes a capture that is piped into it"};
    const int fd = ::dup(STDIN_FILENO);
    std::FILE* stream = fd < 0 ? nullptr : ::fdopen(fd, "rb");
    if (stream == nullptr) {
        const int error = errno;
        if (fd >= 0) ::close(fd);
        return Failure{fmt::format("{} cannot be read: {}", name, std::generic_category().message(error))};
    }
    return CaptureReader::open(name, stream);
}

/// Pipes are read as they come: there is no second look at one.
bool isPipe(const std::string& path) {
    struct stat status {};
    return ::stat(path.c_str(), &status) == 0 && !S_ISREG(status.st_mode) && !S_ISDIR(status.st_mode);
}

Result<CaptureReader> captureInFile(const std::string& path) {
    auto file = RecordingFile::open(path);  // which unpacks it where need be
    if (!file) return file.error();
    std::FILE* stream = RecordingFile::stream(std::move(file).value());
    if (stream == nullptr) return Failure{path + " cannot be opened: no memory"};
    return CaptureReader::open(path, stream);
}

/// The size of a capture's file; none when it is packed.
std::optional<std::uint64_t> sizeOf(const std::string& path) {
    constexpr char kGzip = '\x1F';
    std::error_code error;
    const auto size = std::filesystem::file_size(path, error);
    if (error || size == 0 || std::ifstream(path, std::ios::binary).peek() == kGzip) return std::nullopt;
    return size;
}

/// A file that is no recording at all.
Failure noRecording(const std::string& path) {
    constexpr std::array<std::uint8_t, 4> kPcapng = {0x0A, 0x0D, 0x0D, 0x0A};
    std::array<std::uint8_t, 4> beginning{};
    auto file = RecordingFile::open(path);
    const auto got = file ? file->read(beginning) : Result<std::size_t>(file.error());
    if (!got) return got.error();
    const bool isKnownToReader = *got == 0 || beginning == kPcapng;  // which says what to do with it
    const auto capture = isKnownToReader ? captureInFile(path) : Result<CaptureReader>(Failure{});
    return isKnownToReader && !capture ? capture.error() : Failure{path + " holds no diagnostic records"};
}

}  // namespace

Result<Input> Input::open(const std::string& path, std::optional<Technology> chosen) {
    if (path == kStandardInput) return openCapture(path, chosen);
    if (isPipe(path)) return of(path, CaptureReader::open(path), chosen);
    const auto kind = recognizeRecording(path);
    if (!kind) return kind.error();
    switch (*kind) {
        case RecordingKind::Unknown: return noRecording(path);
        case RecordingKind::Capture: return of(path, captureInFile(path), chosen, sizeOf(path));
        case RecordingKind::Snapshot: return ofSnapshot(path, chosen);
        default: return ofRecording(path, *kind, chosen);
    }
}

Result<Input> Input::openCapture(const std::string& path, std::optional<Technology> chosen) {
    if (path == kStandardInput) return of("standard input", captureFromStandardInput(), chosen);
    auto capture = CaptureReader::open(path);
    if (!capture) return Failure{whyNoCapture(path, capture.error().reason)};
    return of(path, std::move(capture), chosen);
}

Result<Input> Input::of(std::string name, Result<CaptureReader> capture, std::optional<Technology> chosen,
                        std::optional<std::uint64_t> size) {
    if (!capture) return capture.error();
    const auto told = capture->technology();
    const auto technology = chosen ? chosen : told;
    if (!technology) {
        return Failure{name + " has a link type that names no technology; --technology names one"};
    }
    return Input(std::move(name), RecordingKind::Capture, *technology, told,
                 std::make_unique<CaptureRecords>(std::move(capture).value(), size));
}

Result<Input> Input::ofSnapshot(const std::string& path, std::optional<Technology> chosen) {
    auto snapshot = readSnapshot(path);
    if (!snapshot) return snapshot.error();
    const bool holdsTrees = std::ranges::any_of(snapshot->entries, [](const SnapshotFile::Entry& entry) {
        return entry.displayState && entry.displayState.data() == nullptr;
    });
    auto messages = messagesOf(*snapshot, holdsTrees, snapshot->odd);
    if (holdsTrees && !chosen && !messages.empty()) chosen = Technology::IFX;
    const auto technology = chosen ? chosen : technologyOf(messages);
    if (!technology) return nothingToShow(path);
    for (std::string& odd : snapshot->odd) odd = path + ": " + odd;
    return Input(path, RecordingKind::Snapshot, *technology, std::nullopt,
                 std::make_unique<SnapshotRecords>(std::move(messages), std::move(snapshot->odd)));
}

Result<Input> Input::ofRecording(const std::string& path, RecordingKind kind, std::optional<Technology> chosen) {
    RecordSurvey survey;
    {
        auto file = ImportedFile::open(path);
        if (!file) return file.error();
        for (;;) {
            const auto message = file->reader->next();
            if (!message) return message.error();
            if (!*message) break;
            survey.add(**message, false);
        }
    }
    const auto technology = chosen ? chosen : survey.technology();
    if (!technology || !hasCodes(*technology)) return nothingToShow(path);
    auto file = ImportedFile::open(path);
    if (!file) return file.error();
    return Input(path, kind, *technology, std::nullopt,
                 std::make_unique<AdaptedRecording>(path, std::move(file).value(), *technology, survey));
}

std::optional<CapturePacket> Input::next() {
    if (_breakOff) return std::nullopt;
    const auto packet = _records->next();
    if (!packet) {
        _breakOff = packet.error();
        return std::nullopt;
    }
    _count += *packet ? 1 : 0;
    return *packet;
}

bool isReadOnce(const std::string& path) { return path == kStandardInput || isPipe(path); }

std::vector<std::string> filesOf(std::vector<std::string> paths) {
    std::ranges::replace(paths, std::string(kStandardInput), std::string("/dev/stdin"));
    return paths;
}

}  // namespace kelvo
