#pragma once

#include <cstdint>
#include <functional>
#include <string>
#include <vector>

#include "LogGenerator/LogCode.h"
#include "platform/values/Bytes.h"
#include "telephony/adaptation/DerivedIdle.h"
#include "telephony/phone/PhoneState.h"

/// The records that the phone's own services fill, in the fixed layouts.
namespace kelvo::phone {

/// A record without its time.
struct Content {
    LogCode code;
    Bytes payload;

    bool operator==(const Content&) const = default;
};

/// The last real 0xB17F of a cell; null when there is none.
using LastIdle = std::function<const adaptation::IdleCells::Payload*(std::uint32_t earfcn, std::uint16_t pci)>;

/// SIM files, cells and data contexts, each only when something of it is known.
std::vector<Content> serviceContents(const PhoneState& phone);

/// The LTE cell that serves with its levels; none when one of them, or which cell it is, is not told: the record has no
/// way to leave them out.
std::optional<adaptation::ServingLevels> servingLevels(const PhoneState& phone);
/// What `servingLevels` lacks of a phone on LTE: "its channel, RSSI"; empty when it lacks nothing.
std::string missingLevels(const PhoneState& phone);

/// The 0xB17F that is derived from the levels.
Content measurementContent(const adaptation::ServingLevels& levels, const LastIdle& lastIdle);

/// The record, from its log type byte on. `timestamp` is the modem's count (wire::timestampOf).
Bytes recordOf(const Content& content, std::uint64_t timestamp);

/// An identity, short enough to be shown: its last four characters, "…3456"; of a shorter one "…" alone.
std::string shortened(const std::string& identity);

}  // namespace kelvo::phone
