#pragma once

#include "LogGenerator/Base.h"
#include "LogGenerator/UTRAN/UTRANCodes.h"

namespace kelvo {

/// The state of the radio resource control connection (3GPP TS 25.331).
class RRC_State final : public Section<RRC_State> {
public:
    static constexpr std::string_view kSectionName = "RRC Info";
    static constexpr LogCode kLogCodes[] = {code::kUTRANRRCState};

    using Section::Section;
    void updateWithData(ByteView data, LogCode logCode) override;
};

}  // namespace kelvo
