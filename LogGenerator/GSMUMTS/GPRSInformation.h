#pragma once

#include "LogGenerator/Base.h"
#include "LogGenerator/GSMUMTS/GSMUMTSCodes.h"

namespace kelvo {

/// What the serving GSM cell says about its packet service (3GPP TS 44.060, GPRS cell options).
class GPRSInformation final : public Section<GPRSInformation> {
public:
    static constexpr std::string_view kSectionName = "GPRS Information";
    static constexpr LogCode kLogCodes[] = {
        code::kGPRSNetworkControl,    code::kServingPLMN,      code::kGPRSCellOptions, code::kGPRSBroadcastChannel,
        code::kGPRSSystemInformation, code::kGPRSSI13Position, code::kGSMReselection};

    using Section::Section;
    void updateWithData(ByteView data, LogCode logCode) override;
};

}  // namespace kelvo
