#include "tools/share/RecordCopy.h"

#include <algorithm>

#include "LogGenerator/Framing.h"

namespace kelvo {

RecordCopy::RecordCopy(ByteView packet, Bytes& made, Replacer& replacer)
    : _packet(packet), _made(made), _taken(packet.size()), _replacer(replacer) {
    made.assign(packet.size(), 0);
    std::ranges::copy(packet.first(std::min(packet.size(), kPayloadOffset)), made.begin());
}

void RecordCopy::take(std::span<const SharedField> fields, std::size_t base) {
    for (const SharedField& field : fields) {
        const std::size_t at = base + field.at;
        if (at >= size()) continue;
        const std::int64_t value = read(at, field.raw);
        if (field.identity == Identity::None) {
            put(at, field.raw, value);
        } else {
            put(at, field.raw, _replacer.number(field.identity, field.name, static_cast<std::uint32_t>(value)));
        }
    }
}

void RecordCopy::takeEntries(std::size_t start, std::size_t stride, std::size_t count,
                             std::span<const SharedField> fields) {
    for (std::size_t i = 0; i < count && start + stride * i < size(); ++i) take(fields, start + stride * i);
}

void RecordCopy::put(std::size_t at, Raw raw, std::int64_t value) {
    const std::uint64_t mask = ((std::uint64_t{1} << raw.width) - 1) << raw.lowBit;
    const std::uint64_t bits = static_cast<std::uint64_t>(value) << raw.lowBit & mask;
    for (int i = 0; i < raw.bytes; ++i) {
        const std::size_t place = at + static_cast<std::size_t>(i);
        if (place >= size()) return;
        const int shift = 8 * (raw.isBigEndian ? raw.bytes - 1 - i : i);
        const auto free = static_cast<std::uint8_t>(mask >> shift & ~_taken[place] & 0xFF);
        _made[place] = static_cast<std::uint8_t>((_made[place] & ~free) | (bits >> shift & free));
        _taken[place] = static_cast<std::uint8_t>(_taken[place] | (mask >> shift));
    }
}

}  // namespace kelvo
