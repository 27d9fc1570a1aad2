#pragma once

#include "LogGenerator/Base.h"
#include "LogGenerator/UTRAN/UTRANCodes.h"

namespace kelvo {

/// Signal-to-interference values of the coded composite transport channels, one row a channel.
class CCTRCHSIRMeasurement final : public Section<CCTRCHSIRMeasurement> {
public:
    static constexpr std::string_view kSectionName = "CCTRCH SIR";
    static constexpr LogCode kLogCodes[] = {code::kUTRANTransportChannels};

    using Section::Section;
    void updateWithData(ByteView data, LogCode logCode) override;
};

}  // namespace kelvo
