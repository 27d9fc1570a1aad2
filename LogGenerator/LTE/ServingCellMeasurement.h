#pragma once

#include "LogGenerator/Base.h"
#include "LogGenerator/LTE/LTECodes.h"

namespace kelvo {

/// Idle-mode measurement of the serving cell and its cell-reselection criteria (3GPP TS 36.304).
class ServingCellMeasurement final : public Section<ServingCellMeasurement> {
public:
    static constexpr std::string_view kSectionName = "Serving Cell Measurements";
    static constexpr LogCode kLogCodes[] = {code::kLTEServingCellIdle};

    using Section::Section;
    void updateWithData(ByteView data, LogCode logCode) override;
};

}  // namespace kelvo
