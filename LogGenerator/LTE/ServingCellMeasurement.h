#pragma once

#include <array>

#include "LogGenerator/Base.h"

namespace kelvo {

/// Idle-mode measurement of the serving cell and its cell-reselection criteria (3GPP TS 36.304).
class ServingCellMeasurement final : public Section<ServingCellMeasurement> {
public:
    static constexpr std::string_view kSectionName = "Serving Cell Measurements";
    static constexpr std::array<LogCode, 1> kLogCodes = {0xB17F};

    using Section::Section;
    void updateWithData(ByteView data, LogCode logCode) override;
};

}  // namespace kelvo
