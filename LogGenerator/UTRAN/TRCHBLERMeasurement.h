#pragma once

#include <array>

#include "LogGenerator/Base.h"

namespace kelvo {

/// Block error rates of the transport channels, one row a channel.
class TRCHBLERMeasurement final : public Section<TRCHBLERMeasurement> {
public:
    static constexpr std::string_view kSectionName = "TRCH BLER";
    static constexpr std::array<LogCode, 1> kLogCodes = {0xD00C};

    using Section::Section;
    void updateWithData(ByteView data, LogCode logCode) override;
};

}  // namespace kelvo
