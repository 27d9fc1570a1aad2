// Any bytes may come as a recording: whatever it is taken for, each reader gives whole packets only and comes to its
// end.

#include "telephony/recordings/DlfRecording.h"
#include "telephony/recordings/FramesRecording.h"
#include "telephony/recordings/RecordingKind.h"
#include "telephony/wire/LittleEndian.h"
#include "tests/fuzz/InMemoryFile.h"
#include "tests/fuzz/PropertyListRoundTrip.h"

namespace {

using namespace kelvo;

template <class Reader>
void readAll(const std::string& path, std::size_t size) {
    auto file = RecordingFile::open(path);
    fuzz::require(static_cast<bool>(file), "the file cannot be opened");
    Reader reader(std::move(file).value());
    // Packed bytes unpack to a thousand times as many at most; a record has twelve.
    for (std::size_t left = size * 1100 / 12 + 2; left > 0; --left) {
        const auto next = reader.next();
        if (!next || !*next) return reader.damage(), void();
        const ByteView message = (*next)->message;
        fuzz::require(message.size() >= 13 && wire::u16At(message, 1) + 1U == message.size(), "half a record");
    }
    fuzz::require(false, "a recording without an end");
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const fuzz::InMemoryFile file(ByteView(data, size));
    fuzz::require(static_cast<bool>(recognizeRecording(file.path())), "the file cannot be read");
    readAll<FramesRecording>(file.path(), size);
    readAll<DlfRecording>(file.path(), size);
    return 0;
}
