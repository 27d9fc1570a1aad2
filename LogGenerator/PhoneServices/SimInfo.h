#pragma once

#include "LogGenerator/Base.h"
#include "LogGenerator/PhoneServices/PhoneCodes.h"

namespace kelvo {

/// The elementary files of the SIM (3GPP TS 51.011, TS 31.102), shown as the modem formats them.
class SimInfo final : public Section<SimInfo> {
public:
    static constexpr std::string_view kSectionName = "SIM Info";
    static constexpr LogCode kLogCodes[] = {code::kSimFiles};

    using Section::Section;
    void updateWithData(ByteView data, LogCode logCode) override;
};

}  // namespace kelvo
