#include "telephony/wire/RecordConfiguration.h"

#include <algorithm>

#include "telephony/wire/LittleEndian.h"
#include "telephony/wire/Protocol.h"

namespace kelvo::wire {
namespace {

constexpr std::size_t kRequestHeader = 8;
constexpr std::size_t kAnswerHeader = 12;
constexpr std::size_t kMaskHeader = 8;

Bytes header(Operation operation) {
    Bytes bytes{static_cast<std::uint8_t>(Command::RecordConfiguration), 0, 0, 0};
    append32(bytes, static_cast<std::uint32_t>(operation));
    return bytes;
}

Bytes joined(Bytes bytes, ByteView data) {
    bytes.insert(bytes.end(), data.begin(), data.end());
    return bytes;
}

bool isConfiguration(ByteView body, std::size_t size) {
    return body.size() >= size && body[0] == static_cast<std::uint8_t>(Command::RecordConfiguration);
}

}  // namespace

Bytes rangesRequest() { return header(Operation::Ranges); }

Bytes setMaskRequest(const LogMask& mask) { return joined(header(Operation::SetMask), maskData(mask)); }

Bytes getMaskRequest(std::uint32_t equipment) {
    Bytes bytes = header(Operation::GetMask);
    append32(bytes, equipment);
    return bytes;
}

std::optional<ConfigurationRequest> parseConfigurationRequest(ByteView body) {
    if (!isConfiguration(body, kRequestHeader)) return std::nullopt;
    return ConfigurationRequest{Operation{u32At(body, 4)}, body.subspan(kRequestHeader)};
}

std::optional<ConfigurationAnswer> parseConfigurationAnswer(ByteView body) {
    if (!isConfiguration(body, kAnswerHeader)) return std::nullopt;
    return ConfigurationAnswer{Operation{u32At(body, 4)}, u32At(body, 8), body.subspan(kAnswerHeader)};
}

Bytes configurationAnswer(Operation operation, std::uint32_t status, ByteView data) {
    Bytes bytes = header(operation);
    append32(bytes, status);
    return joined(std::move(bytes), data);
}

std::optional<Ranges> parseRanges(ByteView data) {
    Ranges ranges{};
    if (data.size() < 4 * ranges.size()) return std::nullopt;
    for (std::size_t id = 0; id < ranges.size(); ++id) ranges[id] = std::min(u32At(data, 4 * id), kMostItems);
    return ranges;
}

std::optional<LogMask> parseMask(ByteView data) {
    if (data.size() < kMaskHeader) return std::nullopt;
    const std::uint32_t items = std::min(u32At(data, 4), kMostItems);
    if (data.size() - kMaskHeader < (items + 7) / 8) return std::nullopt;
    return LogMask(u32At(data, 0), items, data.subspan(kMaskHeader));
}

Bytes rangesData(const Ranges& ranges) {
    Bytes data;
    for (const std::uint32_t items : ranges) append32(data, items);
    return data;
}

Bytes maskData(const LogMask& mask) {
    Bytes data;
    append32(data, mask.equipment());
    append32(data, mask.items());
    return joined(std::move(data), mask.bits());
}

std::optional<std::uint32_t> equipmentOf(ByteView data) {
    return data.size() < 4 ? std::nullopt : std::optional(u32At(data, 0));
}

}  // namespace kelvo::wire
