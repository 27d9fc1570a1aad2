#pragma once

#include "LogGenerator/FieldTable.h"
#include "LogGenerator/UTRAN/UTRANCodes.h"

namespace kelvo {

/// 0xD00C: the transport channels with their block error rates, then the coded composite ones with their SIR.
struct TransportChannelsRecord {
    static constexpr std::size_t kMinimum = 17;
    static constexpr Raw kChannelCount = u16.bits(6, 11);        // at 14
    static constexpr Raw kCodedChannelCount = u16.bits(12, 15);  // at 14

    // clang-format off
    static constexpr auto kChannel = entry(2, {
        { 0, u8, "TRCH ID",               decimal },
        { 1, u8, "TRCH BLER Measurement", decimal },
    });
    static constexpr auto kCodedChannel = entry(8, {  // and at 2 the SIR of six timeslots, a byte each
        { 0, u8, "CCTRCH ID",             decimal },
        { 1, u8, "TSNUM",                 decimal },
    });
    // clang-format on

    static RecordEntries channels(RecordView record) {
        return kChannel.entries(kMinimum, record.count(14, kChannelCount));
    }
    static RecordEntries codedChannels(RecordView record) {
        const std::size_t start = 289 + 34 * record.count(14, kChannelCount);
        return kCodedChannel.entries(start, record.count(14, kCodedChannelCount));
    }
    static RecordEntries timeslots(std::size_t codedChannel) { return {codedChannel + 2, 1, 6}; }
};

}  // namespace kelvo
