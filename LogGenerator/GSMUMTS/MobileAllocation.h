#pragma once

#include "LogGenerator/Base.h"
#include "LogGenerator/GSMUMTS/GSMUMTSCodes.h"

namespace kelvo {

/// The channels of the hopping sequence and its number (3GPP TS 44.018, mobile allocation).
class MobileAllocation final : public Section<MobileAllocation> {
public:
    static constexpr std::string_view kSectionName = "Mobile Allocation";
    static constexpr LogCode kLogCodes[] = {code::kMobileAllocation};

    using Section::Section;
    void updateWithData(ByteView data, LogCode logCode) override;
};

}  // namespace kelvo
