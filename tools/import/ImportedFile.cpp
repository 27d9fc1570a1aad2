#include "tools/import/ImportedFile.h"

#include <fmt/format.h>

#include "platform/host/Capture.h"
#include "telephony/recordings/DlfRecording.h"
#include "telephony/recordings/FramesRecording.h"
#include "telephony/recordings/RecordingFile.h"
#include "tools/ReadSnapshot.h"
#include "tools/SnapshotCapture.h"

namespace kelvo {

namespace {

/// The messages of a capture, with the times that it gives them.
class CaptureRecording final : public RecordingReader {
public:
    explicit CaptureRecording(CaptureReader reader) : _reader(std::move(reader)) {}

    Result<std::optional<RecordedMessage>> next() override {
        if (_damage.isCut) return std::optional<RecordedMessage>();
        const auto packet = _reader.next();
        _damage.isCut = !packet;  // what came before is good all the same
        if (!packet || !*packet) return std::optional<RecordedMessage>();
        return std::optional(RecordedMessage{(*packet)->bytes, (*packet)->time, std::nullopt});
    }
    RecordingDamage damage() const override { return _damage; }

private:
    CaptureReader _reader;
    RecordingDamage _damage;
};

/// The messages of a snapshot's history.
class SnapshotRecording final : public RecordingReader {
public:
    explicit SnapshotRecording(std::vector<SnapshotMessage> messages) : _messages(std::move(messages)) {}

    Result<std::optional<RecordedMessage>> next() override {
        if (_next == _messages.size()) return std::optional<RecordedMessage>();
        const SnapshotMessage& message = _messages[_next++];
        return std::optional(RecordedMessage{message.bytes, message.time, std::nullopt});
    }
    RecordingDamage damage() const override { return {}; }

private:
    std::vector<SnapshotMessage> _messages;
    std::size_t _next = 0;
};

Result<ImportedFile> openCapture(const std::string& path, RecordingFile file) {
    std::FILE* stream = RecordingFile::stream(std::move(file));
    if (stream == nullptr) return Failure{path + " cannot be opened: no memory"};
    auto capture = CaptureReader::open(path, stream);
    if (!capture) return capture.error();
    const auto technology = capture->technology();
    ImportedFile imported{.kind = RecordingKind::Capture, .holdsTrees = technology && !hasCodes(*technology)};
    imported.reader = std::make_unique<CaptureRecording>(std::move(capture).value());
    return imported;
}

Result<ImportedFile> openSnapshot(const std::string& path) {
    auto snapshot = readSnapshot(path);
    if (!snapshot) return snapshot.error();
    ImportedFile imported{.kind = RecordingKind::Snapshot, .odd = snapshot->odd};
    for (const SnapshotFile::Entry& entry : snapshot->entries) {
        imported.holdsTrees |= entry.displayState && entry.displayState.data() == nullptr;
    }
    imported.reader = std::make_unique<SnapshotRecording>(messagesOf(*snapshot, imported.holdsTrees, imported.odd));
    return imported;
}

}  // namespace

Result<ImportedFile> ImportedFile::open(const std::string& path) {
    const auto kind = recognizeRecording(path);
    if (!kind) return kind.error();
    if (*kind == RecordingKind::Unknown) return Failure{path + " holds no diagnostic records"};
    if (*kind == RecordingKind::Snapshot) return openSnapshot(path);
    auto file = RecordingFile::open(path);
    if (!file) return file.error();
    if (*kind == RecordingKind::Capture) return openCapture(path, std::move(file).value());
    ImportedFile imported{.kind = *kind};
    if (*kind == RecordingKind::Frames) {
        imported.reader = std::make_unique<FramesRecording>(std::move(file).value());
    } else {
        imported.reader = std::make_unique<DlfRecording>(std::move(file).value());
    }
    return imported;
}

std::vector<std::string> damageOf(const std::string& path, const ImportedFile& file) {
    const RecordingDamage damage = file.reader->damage();
    std::vector<std::string> lines;
    const auto add = [&](std::uint64_t count, std::string_view what) {
        if (count != 0) lines.push_back(fmt::format("{}: {} {}", path, count, what));
    };
    add(damage.damagedFrames, "damaged frames left out");
    add(damage.skippedBytes, "bytes between records skipped");
    add(damage.encryptedRecords, "records are encrypted by the modem");
    if (!file.odd.empty()) lines.push_back(path + ": " + file.odd.front());
    return lines;
}

}  // namespace kelvo
