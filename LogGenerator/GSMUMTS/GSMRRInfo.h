#pragma once

#include "LogGenerator/Base.h"
#include "LogGenerator/GSMUMTS/GSMUMTSCodes.h"

namespace kelvo {

/// The GSM radio resource layer (3GPP TS 44.018): its state, levels and reception modes.
class GSMRRInfo final : public Section<GSMRRInfo> {
public:
    static constexpr std::string_view kSectionName = "GSM RR Info";
    static constexpr LogCode kLogCodes[] = {code::kGSMRRState, code::kGSMReselection, code::kGSMDTX,
                                            code::kGPRSCellOptions};

    using Section::Section;
    void updateWithData(ByteView data, LogCode logCode) override;
};

}  // namespace kelvo
