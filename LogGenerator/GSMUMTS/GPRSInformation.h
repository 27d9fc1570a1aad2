#pragma once

#include <array>

#include "LogGenerator/Base.h"

namespace kelvo {

/// What the serving GSM cell says about its packet service (3GPP TS 44.060, GPRS cell options).
class GPRSInformation final : public Section<GPRSInformation> {
public:
    static constexpr std::string_view kSectionName = "GPRS Information";
    static constexpr std::array<LogCode, 7> kLogCodes = {0x51f5, 0x7135, 0x51f6, 0x51fb, 0x51fd, 0x51f4, 0x5137};

    using Section::Section;
    void updateWithData(ByteView data, LogCode logCode) override;
};

}  // namespace kelvo
