#pragma once

#include "LogGenerator/LTE/ReselectionCandidatesRecord.h"
#include "LogGenerator/LayoutSection.h"

namespace kelvo {

/// The cell that the reselection candidates would replace; the candidates are ReselectionCandidatesList's.
class ReselectionCandidatesMisc final
    : public LayoutSection<ReselectionCandidatesMisc, ReselectionCandidatesRecord::kServingCell> {
public:
    static constexpr std::string_view kSectionName = "Reselection Candidates";
    static constexpr std::string_view kTraceWord = kSectionName;

    using LayoutSection::LayoutSection;
};

}  // namespace kelvo
