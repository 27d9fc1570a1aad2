#pragma once

#include "LogGenerator/Base.h"
#include "LogGenerator/GSMUMTS/GSMUMTSCodes.h"

namespace kelvo {

/// The networks that count as equivalent to the serving one.
class EquivalentPLMNList final : public Section<EquivalentPLMNList> {
public:
    static constexpr std::string_view kSectionName = "Equivalent PLMN List";
    static constexpr LogCode kLogCodes[] = {code::kEquivalentPLMNs};

    using Section::Section;
    void updateWithData(ByteView data, LogCode logCode) override;
};

}  // namespace kelvo
