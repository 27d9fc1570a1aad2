#pragma once

#include <array>

#include "LogGenerator/Base.h"

namespace kelvo {

/// Signal-to-interference values of the coded composite transport channels, one row a channel.
class CCTRCHSIRMeasurement final : public Section<CCTRCHSIRMeasurement> {
public:
    static constexpr std::string_view kSectionName = "CCTRCH SIR";
    static constexpr std::array<LogCode, 1> kLogCodes = {0xD00C};

    using Section::Section;
    void updateWithData(ByteView data, LogCode logCode) override;
};

}  // namespace kelvo
