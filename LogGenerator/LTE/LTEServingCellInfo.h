#pragma once

#include <array>

#include "LogGenerator/Base.h"

namespace kelvo {

/// The serving cell: identity, frequencies, bandwidths, transmit antennas.
class LTEServingCellInfo final : public Section<LTEServingCellInfo> {
public:
    static constexpr std::string_view kSectionName = "Serving Cell Info";
    static constexpr std::array<LogCode, 3> kLogCodes = {0xB0C2, 0xB0C1, 0xFF0001};

    using Section::Section;
    void updateWithData(ByteView data, LogCode logCode) override;
};

}  // namespace kelvo
