#pragma once

#include <array>

#include "LogGenerator/Base.h"

namespace kelvo {

/// Block errors of the UMTS transport channels.
class BLER final : public Section<BLER> {
public:
    static constexpr std::string_view kSectionName = "BLER";
    static constexpr std::array<LogCode, 1> kLogCodes = {0x4116};

    using Section::Section;
    void updateWithData(ByteView data, LogCode logCode) override;
};

}  // namespace kelvo
