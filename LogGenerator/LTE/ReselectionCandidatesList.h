#pragma once

#include "LogGenerator/Base.h"
#include "LogGenerator/LTE/LTECodes.h"

namespace kelvo {

/// The cells the phone may reselect to (3GPP TS 36.304), in LTE or another technology, one row a candidate.
class ReselectionCandidatesList final : public Section<ReselectionCandidatesList> {
public:
    static constexpr std::string_view kSectionName = "Reselection Candidates List";
    static constexpr LogCode kLogCodes[] = {code::kLTEReselectionCandidates};

    using Section::Section;
    void updateWithData(ByteView data, LogCode logCode) override;
};

}  // namespace kelvo
