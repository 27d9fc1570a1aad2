#include "telephony/phone/PhoneRecords.h"

#include <algorithm>
#include <array>

#include "platform/encodings/PropertyList.h"
#include "platform/values/Value.h"

namespace kelvo::phone {
namespace {

constexpr LogCode kSimFiles = 0xFF0000;
constexpr LogCode kCellInformation = 0xFF0001;
constexpr LogCode kPdpContexts = 0xFF0002;
constexpr LogCode kIdleMeasurement = 0xB17F;

constexpr std::uint8_t kOrdinaryType = 1;
constexpr std::uint8_t kExtendedType = 255;
constexpr std::size_t kHeader = 13;
constexpr std::size_t kGreatestRecord = 65536;  // its length less one has 16 bits
constexpr int kGreatestPci = 503;
constexpr std::size_t kShownOfIdentity = 4;

void add(std::vector<Content>& contents, LogCode code, const Value& payload) {
    auto encoded = writeXmlPropertyList(payload);
    if (encoded && kHeader + encoded->size() <= kGreatestRecord) contents.push_back({code, std::move(*encoded)});
}

const MonitoredCell* servingLteCell(const PhoneState& phone) {
    if (!phone.cells) return nullptr;
    const auto cell = std::ranges::find_if(*phone.cells, [](const MonitoredCell& candidate) {
        return candidate.isServing && candidate.technology == MonitoredCell::Technology::LTE;
    });
    return cell != phone.cells->end() ? &*cell : nullptr;
}

bool hasChannel(const MonitoredCell* cell) { return cell != nullptr && cell->uarfcn && *cell->uarfcn >= 0; }

bool hasPci(const MonitoredCell* cell) {
    return cell != nullptr && cell->pid && *cell->pid >= 0 && *cell->pid <= kGreatestPci;
}

void put(Bytes& bytes, std::size_t at, std::uint64_t value, int width) {
    for (int i = 0; i < width; ++i)
        bytes[at + static_cast<std::size_t>(i)] = static_cast<std::uint8_t>(value >> (8 * i));
}

}  // namespace

std::vector<Content> serviceContents(const PhoneState& phone) {
    std::vector<Content> contents;
    if (phone.sim != SimFiles{}) add(contents, kSimFiles, simFilesPayload(phone.sim));
    if (phone.cells) add(contents, kCellInformation, cellInformationPayload(*phone.cells));
    if (phone.contexts) add(contents, kPdpContexts, pdpContextsPayload(*phone.contexts));
    return contents;
}

std::optional<adaptation::ServingLevels> servingLevels(const PhoneState& phone) {
    const MonitoredCell* cell = servingLteCell(phone);
    if (phone.family != Technology::LTE || !missingLevels(phone).empty()) return std::nullopt;
    return adaptation::ServingLevels{.earfcn = static_cast<std::uint32_t>(*cell->uarfcn),
                                     .pci = static_cast<std::uint16_t>(*cell->pid),
                                     .rsrp = *phone.lte.rsrp,
                                     .rsrq = *phone.lte.rsrq,
                                     .rssi = *phone.lte.rssi};
}

std::string missingLevels(const PhoneState& phone) {
    if (phone.family != Technology::LTE) return {};
    const MonitoredCell* cell = servingLteCell(phone);
    const std::pair<bool, const char*> needed[] = {{hasChannel(cell), "its channel"},
                                                   {hasPci(cell), "its physical cell identity"},
                                                   {phone.lte.rsrp.has_value(), "RSRP"},
                                                   {phone.lte.rsrq.has_value(), "RSRQ"},
                                                   {phone.lte.rssi.has_value(), "RSSI"}};
    std::string missing;
    for (const auto& [isThere, what] : needed) {
        if (!isThere) missing += (missing.empty() ? "" : ", ") + std::string(what);
    }
    return missing;
}

Content measurementContent(const adaptation::ServingLevels& levels, const LastIdle& lastIdle) {
    const auto payload = adaptation::derivedIdle(levels, lastIdle ? lastIdle(levels.earfcn, levels.pci) : nullptr);
    return {kIdleMeasurement, {payload.begin(), payload.end()}};
}

Bytes recordOf(const Content& content, std::uint64_t timestamp) {
    Bytes record(kHeader + content.payload.size());
    put(record, 0, content.code >= kExtendedLogCodes ? kExtendedType : kOrdinaryType, 1);
    put(record, 1, kHeader + content.payload.size() - 1, 2);  // counts from offset 1
    put(record, 3, content.code & 0xFFFF, 2);
    put(record, 5, timestamp, 8);
    std::ranges::copy(content.payload, record.begin() + kHeader);
    return record;
}

std::string shortened(const std::string& identity) {
    const std::size_t shown = identity.size() > 2 * kShownOfIdentity ? kShownOfIdentity : 0;
    return "…" + identity.substr(identity.size() - shown);
}

}  // namespace kelvo::phone
