#include "telephony/line/DeviceEnvelope.h"

#include "telephony/wire/LittleEndian.h"

namespace kelvo {
namespace {

constexpr std::uint32_t kKind = 32;
constexpr std::size_t kHeader = 8;
constexpr std::size_t kLength = 4;

}  // namespace

Bytes DeviceEnvelope::wrap(ByteView frame) {
    Bytes bytes;
    bytes.reserve(kLength + frame.size());
    wire::append32(bytes, kKind);
    bytes.insert(bytes.end(), frame.begin(), frame.end());
    return bytes;
}

bool DeviceEnvelope::unwrap(std::span<std::uint8_t> read, const std::function<void(std::span<std::uint8_t>)>& take) {
    if (read.size() < kHeader || wire::u32At(read, 0) != kKind) return false;
    const std::uint32_t pieces = wire::u32At(read, 4);
    std::span<std::uint8_t> rest = read.subspan(kHeader);
    for (std::uint32_t i = 0; i < pieces; ++i) {
        if (rest.size() < kLength) return false;
        const std::size_t length = wire::u32At(rest, 0);
        rest = rest.subspan(kLength);
        if (length > rest.size()) return false;
        take(rest.first(length));
        rest = rest.subspan(length);
    }
    return true;
}

}  // namespace kelvo
