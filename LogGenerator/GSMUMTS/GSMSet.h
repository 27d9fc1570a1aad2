#pragma once

#include <array>

#include "LogGenerator/Base.h"

namespace kelvo {

/// GSM neighbors by their rank for cell reselection.
class GSMSet final : public Section<GSMSet> {
public:
    static constexpr std::string_view kSectionName = "GSM Set";
    static constexpr std::array<LogCode, 1> kLogCodes = {0x4005};

    using Section::Section;
    void updateWithData(ByteView data, LogCode logCode) override;
};

}  // namespace kelvo
