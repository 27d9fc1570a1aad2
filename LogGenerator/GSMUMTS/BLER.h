#pragma once

#include "LogGenerator/Base.h"
#include "LogGenerator/GSMUMTS/GSMUMTSCodes.h"

namespace kelvo {

/// Block errors of the UMTS transport channels.
class BLER final : public Section<BLER> {
public:
    static constexpr std::string_view kSectionName = "BLER";
    static constexpr LogCode kLogCodes[] = {code::kUMTSTransportErrors};

    using Section::Section;
    void updateWithData(ByteView data, LogCode logCode) override;
};

}  // namespace kelvo
