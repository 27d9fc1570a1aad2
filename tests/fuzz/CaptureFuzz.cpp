// Any bytes may come as a capture file; the packets that are read can be written, and read back the same.

#include "platform/host/Capture.h"

#include <fmt/format.h>
#include <unistd.h>

#include <string>
#include <vector>

#include "platform/system/MessagePorts.h"
#include "tests/fuzz/InMemoryFile.h"
#include "tests/fuzz/PropertyListRoundTrip.h"

namespace {

using namespace kelvo;

std::vector<Bytes> readAll(const std::string& path) {
    std::vector<Bytes> packets;
    auto reader = CaptureReader::open(path);
    if (!reader) return packets;
    reader->technology();
    while (true) {
        const auto packet = reader->next();
        if (!packet || !*packet) return packets;
        fuzz::require((*packet)->bytes.size() <= kMaxMessageSize, "a packet longer than any message");
        packets.emplace_back((*packet)->bytes.begin(), (*packet)->bytes.end());
    }
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const std::vector<Bytes> packets = readAll(fuzz::InMemoryFile({data, size}).path());
    if (packets.empty()) return 0;
    const std::string copy = fmt::format("/dev/shm/kelvo-capture-fuzz.{}", ::getpid());  // never reaches a disk
    auto writer = CaptureWriter::create(OutputFile::create(copy).value(), Technology::LTE);
    fuzz::require(static_cast<bool>(writer), "no copy can be made");
    for (const Bytes& packet : packets) {
        fuzz::require(static_cast<bool>(writer->append({}, packet)), "a packet cannot be written");
    }
    fuzz::require(static_cast<bool>(writer->appear()), "the copy does not appear");
    const bool same = readAll(copy) == packets;
    ::unlink(copy.c_str());
    fuzz::require(same, "what was written reads back as something else");
    return 0;
}
