#pragma once

#include <array>

#include "LogGenerator/Base.h"

namespace kelvo {

/// The cell that the reselection candidates would replace; the candidates are ReselectionCandidatesList's.
class ReselectionCandidatesMisc final : public Section<ReselectionCandidatesMisc> {
public:
    static constexpr std::string_view kSectionName = "Reselection Candidates";
    static constexpr std::array<LogCode, 1> kLogCodes = {0xB186};

    using Section::Section;
    void updateWithData(ByteView data, LogCode logCode) override;
};

}  // namespace kelvo
