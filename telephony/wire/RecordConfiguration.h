#pragma once

#include <array>
#include <cstdint>
#include <optional>

#include "telephony/wire/LogMask.h"

/// The record configuration (0x73): what a modem has, and what it is to send.
///
///     request   0x73, three zero bytes, u32 operation, data
///     answer    0x73, three zero bytes, u32 operation, u32 status, data
namespace kelvo::wire {

enum class Operation : std::uint32_t { AllOff = 0, Ranges = 1, SetMask = 3, GetMask = 4 };

/// How many items each equipment has; 0: the modem has none of it.
using Ranges = std::array<std::uint32_t, kEquipmentIds>;

Bytes rangesRequest();
/// Replaces the whole mask of its equipment.
Bytes setMaskRequest(const LogMask& mask);
Bytes getMaskRequest(std::uint32_t equipment);

/// A request as the modem reads it.
struct ConfigurationRequest {
    Operation operation{};
    ByteView data;
};
/// None when the body is no request of the record configuration, or too short.
std::optional<ConfigurationRequest> parseConfigurationRequest(ByteView body);

/// An answer as the reader reads it.
struct ConfigurationAnswer {
    Operation operation{};
    std::uint32_t status = 0;  ///< 0: good
    ByteView data;
};
/// None when the body is no answer of the record configuration, or too short for its status.
std::optional<ConfigurationAnswer> parseConfigurationAnswer(ByteView body);
Bytes configurationAnswer(Operation operation, std::uint32_t status, ByteView data = {});

/// The data of an answer to Ranges, and of one to SetMask and GetMask (and of a request to set): none when they are too
/// short. Items beyond kMostItems are no records, and left out.
std::optional<Ranges> parseRanges(ByteView data);
std::optional<LogMask> parseMask(ByteView data);
Bytes rangesData(const Ranges& ranges);
Bytes maskData(const LogMask& mask);
/// The equipment that such data begin with; none when there are none.
std::optional<std::uint32_t> equipmentOf(ByteView data);

}  // namespace kelvo::wire
