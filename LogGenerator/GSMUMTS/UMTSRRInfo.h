#pragma once

#include "LogGenerator/Base.h"
#include "LogGenerator/GSMUMTS/GSMUMTSCodes.h"
#include "LogGenerator/PhoneServices/PhoneCodes.h"

namespace kelvo {

/// The radio connection of the serving UMTS cell (3GPP TS 25.331).
class UMTSRRInfo final : public Section<UMTSRRInfo> {
public:
    static constexpr std::string_view kSectionName = "UMTS RR Info";
    static constexpr LogCode kLogCodes[] = {code::kUMTSRRCState, code::kUMTSTransmitPower, code::kUMTSServingCell,
                                            code::kUMTSCiphering, code::kCellArray};

    using Section::Section;
    void updateWithData(ByteView data, LogCode logCode) override;

private:
    void showTransmitPower(ByteView data);
};

}  // namespace kelvo
