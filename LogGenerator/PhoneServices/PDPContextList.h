#pragma once

#include "LogGenerator/Base.h"
#include "LogGenerator/PhoneServices/PhoneCodes.h"

namespace kelvo {

/// The packet data contexts, shown as the modem delivers them.
class PDPContextList final : public Section<PDPContextList> {
public:
    static constexpr std::string_view kSectionName = "PDP Context Info";
    static constexpr LogCode kLogCodes[] = {code::kPDPContexts};

    using Section::Section;
    void updateWithData(ByteView data, LogCode logCode) override;
};

}  // namespace kelvo
