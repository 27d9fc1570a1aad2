#pragma once

#include "LogGenerator/Base.h"
#include "LogGenerator/GSMUMTS/GSMUMTSCodes.h"
#include "LogGenerator/PhoneServices/PhoneCodes.h"

namespace kelvo {

/// The serving GSM cell: identity, channel, level and reselection criteria.
class GSMServingCell final : public Section<GSMServingCell> {
public:
    static constexpr std::string_view kSectionName = "GSM Serving Cell";
    static constexpr LogCode kLogCodes[] = {code::kGSMServingCell, code::kGSMReselection, code::kGSMDedicatedChannel,
                                            code::kCellArray};

    using Section::Section;
    void updateWithData(ByteView data, LogCode logCode) override;
};

}  // namespace kelvo
