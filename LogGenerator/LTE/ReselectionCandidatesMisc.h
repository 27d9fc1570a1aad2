#pragma once

#include "LogGenerator/Base.h"
#include "LogGenerator/LTE/LTECodes.h"

namespace kelvo {

/// The cell that the reselection candidates would replace; the candidates are ReselectionCandidatesList's.
class ReselectionCandidatesMisc final : public Section<ReselectionCandidatesMisc> {
public:
    static constexpr std::string_view kSectionName = "Reselection Candidates";
    static constexpr LogCode kLogCodes[] = {code::kLTEReselectionCandidates};

    using Section::Section;
    void updateWithData(ByteView data, LogCode logCode) override;
};

}  // namespace kelvo
