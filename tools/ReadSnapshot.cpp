#include "tools/ReadSnapshot.h"

#include <span>

#include "telephony/recordings/RecordingFile.h"

namespace kelvo {

namespace {

Result<Bytes> readFile(const std::string& name) {
    auto file = RecordingFile::open(name);
    if (!file) return file.error();
    Bytes bytes;
    constexpr std::size_t kChunk = 1 << 16;
    std::size_t count = kChunk;
    while (count == kChunk) {
        const std::size_t length = bytes.size();
        bytes.resize(length + kChunk);
        const auto got = file->read(std::span(bytes).subspan(length));
        if (!got) return got.error();
        count = *got;
        bytes.resize(length + count);
    }
    return bytes;
}

}  // namespace

Result<SnapshotFile> readSnapshot(const std::string& path) {
    const Result<Bytes> bytes = readFile(path);
    if (!bytes) return bytes.error();
    return SnapshotFile::read(path, *bytes);
}

}  // namespace kelvo
