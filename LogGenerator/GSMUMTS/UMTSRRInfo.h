#pragma once

#include <array>

#include "LogGenerator/Base.h"

namespace kelvo {

/// The radio connection of the serving UMTS cell (3GPP TS 25.331).
class UMTSRRInfo final : public Section<UMTSRRInfo> {
public:
    static constexpr std::string_view kSectionName = "UMTS RR Info";
    static constexpr std::array<LogCode, 5> kLogCodes = {0x4125, 0x4031, 0x4127, 0x4157, 0xff0001};

    using Section::Section;
    void updateWithData(ByteView data, LogCode logCode) override;

private:
    void showTransmitPower(ByteView data);
};

}  // namespace kelvo
