#include "telephony/recordings/RecordingKind.h"

#include <algorithm>
#include <array>

#include "platform/encodings/PropertyList.h"
#include "telephony/recordings/DlfRecording.h"
#include "telephony/recordings/FramesRecording.h"
#include "telephony/recordings/RecordingFile.h"
#include "telephony/wire/LittleEndian.h"

namespace kelvo {

namespace {

constexpr std::size_t kBeginning = 1024 * 1024;

bool isCapture(ByteView bytes) {
    if (bytes.size() < 4) return false;
    const std::uint32_t magic = wire::u32At(bytes, 0);
    return magic == 0xA1B2C3D4 || magic == 0xD4C3B2A1 || magic == 0xA1B23C4D || magic == 0x4D3CB2A1;
}

/// A checksum may be right by chance, but hardly in a record whose two lengths are right as well.
bool holdsFrames(ByteView bytes) {
    Bytes copy(bytes.begin(), bytes.end());
    wire::MutableBytes input(copy);
    wire::FrameReader frames;
    while (const auto body = frames.next(input)) {
        if (framedRecord(*body)) return true;
    }
    return false;
}

bool holdsRecords(ByteView bytes) {
    constexpr int kFollowing = 4;  // noise looks like one record often enough, and like five in a row never
    for (std::size_t at = 0; at < bytes.size(); ++at) {
        if (dlfRecordAt(bytes.subspan(at), kFollowing)) return true;
    }
    return false;
}

}  // namespace

std::string_view nameOf(RecordingKind kind) {
    switch (kind) {
        case RecordingKind::Capture: return "a capture";
        case RecordingKind::Snapshot: return "a property list";
        case RecordingKind::Frames: return "a stream of diagnostic frames";
        case RecordingKind::Dlf: return "a DLF file";
        case RecordingKind::Unknown: return "no recording";
    }
    return "";
}

RecordingKind recognizeRecording(ByteView beginning) {
    if (isCapture(beginning)) return RecordingKind::Capture;
    if (beginsPropertyList(beginning)) return RecordingKind::Snapshot;
    if (holdsFrames(beginning)) return RecordingKind::Frames;
    if (holdsRecords(beginning)) return RecordingKind::Dlf;
    return RecordingKind::Unknown;
}

Result<RecordingKind> recognizeRecording(const std::string& path) {
    auto file = RecordingFile::open(path);
    if (!file) return file.error();
    Bytes beginning(kBeginning);
    const auto got = file->read(beginning);
    if (!got) return got.error();
    beginning.resize(*got);
    return recognizeRecording(beginning);
}

std::string whyNoCapture(const std::string& path, const std::string& reason) {
    const auto kind = recognizeRecording(path);
    if (!kind || *kind == RecordingKind::Unknown || *kind == RecordingKind::Capture) return reason;
    return path + ": this is " + std::string(nameOf(*kind)) + "; kelvoctl import makes a capture of it";
}

}  // namespace kelvo
