#pragma once

#include <cstdint>
#include <map>
#include <optional>
#include <string>
#include <utility>
#include <vector>

#include "telephony/adaptation/RecordAdapter.h"

namespace kelvo::adaptation {

/// Counts what became of records. Allocates only for what it has not seen before.
class AdaptationMeter {
public:
    /// Counts one; the line to log when it is the first of its kind that is refused.
    std::optional<std::string> count(const Adapted& adapted);

    std::uint64_t passed() const { return _passed; }
    std::uint64_t turned() const { return _turned; }
    std::uint64_t refused() const { return _refused; }
    std::uint64_t derived() const { return _completed + _neutral; }  ///< 0xB17F made of 0xB193
    /// Of these, how many lack priority, limits, search thresholds and rules: of a cell without a real 0xB17F.
    std::uint64_t neutral() const { return _neutral; }
    std::uint64_t extendedChannels() const { return _extendedChannels; }
    std::optional<std::uint32_t> lastExtendedChannel() const { return _lastExtendedChannel; }
    std::uint64_t leftOut() const { return _leftOut; }  ///< list entries that the fixed layout cannot say

    struct Refused {
        std::string what;  ///< "0xB193 version 1, part 25 version 59, 524 bytes: not known"
        LogCode code;
        std::uint64_t records;
    };
    /// By code, version and length.
    std::vector<Refused> refusals() const;

    /// For people: a line for each count that is not 0; empty when every record passed.
    std::vector<std::string> lines() const;

private:
    std::uint64_t _passed = 0;
    std::uint64_t _turned = 0;
    std::uint64_t _refused = 0;
    std::uint64_t _completed = 0;
    std::uint64_t _neutral = 0;
    std::uint64_t _extendedChannels = 0;
    std::uint64_t _leftOut = 0;
    std::optional<std::uint32_t> _lastExtendedChannel;
    std::map<std::pair<RecordKind, Refusal>, std::uint64_t> _refusals;
};

}  // namespace kelvo::adaptation
