#pragma once

#include "LogGenerator/Base.h"
#include "LogGenerator/LTE/LTECodes.h"
#include "LogGenerator/PhoneServices/PhoneCodes.h"

namespace kelvo {

/// The serving cell: identity, frequencies, bandwidths, transmit antennas.
class LTEServingCellInfo final : public Section<LTEServingCellInfo> {
public:
    static constexpr std::string_view kSectionName = "Serving Cell Info";
    static constexpr LogCode kLogCodes[] = {code::kLTEServingCell, code::kLTEMasterInformationBlock, code::kCellArray};

    using Section::Section;
    void updateWithData(ByteView data, LogCode logCode) override;
};

}  // namespace kelvo
