#pragma once

#include <array>

#include "LogGenerator/Base.h"

namespace kelvo {

/// The GSM radio resource layer (3GPP TS 44.018): its state, levels and reception modes.
class GSMRRInfo final : public Section<GSMRRInfo> {
public:
    static constexpr std::string_view kSectionName = "GSM RR Info";
    static constexpr std::array<LogCode, 4> kLogCodes = {0x512c, 0x5137, 0x5072, 0x51f6};

    using Section::Section;
    void updateWithData(ByteView data, LogCode logCode) override;
};

}  // namespace kelvo
