#pragma once

#include <array>

#include "LogGenerator/Base.h"

namespace kelvo {

/// The packet data contexts, shown as the modem delivers them.
class PDPContextList final : public Section<PDPContextList> {
public:
    static constexpr std::string_view kSectionName = "PDP Context Info";
    static constexpr std::array<LogCode, 1> kLogCodes = {0xff0002};

    using Section::Section;
    void updateWithData(ByteView data, LogCode logCode) override;
};

}  // namespace kelvo
