#pragma once

#include <array>

#include "LogGenerator/Base.h"

namespace kelvo {

/// The serving GSM cell: identity, channel, level and reselection criteria.
class GSMServingCell final : public Section<GSMServingCell> {
public:
    static constexpr std::string_view kSectionName = "GSM Serving Cell";
    static constexpr std::array<LogCode, 4> kLogCodes = {0x5134, 0x5137, 0x5076, 0xff0001};

    using Section::Section;
    void updateWithData(ByteView data, LogCode logCode) override;
};

}  // namespace kelvo
