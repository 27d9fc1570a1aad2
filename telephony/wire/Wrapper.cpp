#include "telephony/wire/Wrapper.h"

#include "telephony/wire/LittleEndian.h"
#include "telephony/wire/Protocol.h"

namespace kelvo::wire {
namespace {

constexpr std::size_t kHeader = 8;
constexpr std::uint8_t kKind = 1;

}  // namespace

std::optional<Wrapped> unwrap(MutableBytes body) {
    if (body.size() <= kHeader || body[0] != static_cast<std::uint8_t>(Command::MultiRadio) || body[1] != kKind)
        return std::nullopt;
    return Wrapped{static_cast<std::int32_t>(u32At(body, 4)), body.subspan(kHeader)};
}

Bytes wrap(std::int32_t subscription, ByteView body) {
    Bytes wrapped{static_cast<std::uint8_t>(Command::MultiRadio), kKind, 0, 0};
    append32(wrapped, static_cast<std::uint32_t>(subscription));
    wrapped.insert(wrapped.end(), body.begin(), body.end());
    return wrapped;
}

}  // namespace kelvo::wire
