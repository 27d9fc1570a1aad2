#pragma once

#include "LogGenerator/Base.h"
#include "LogGenerator/GSMUMTS/GSMUMTSCodes.h"

namespace kelvo {

/// GSM neighbors by their rank for cell reselection.
class GSMSet final : public Section<GSMSet> {
public:
    static constexpr std::string_view kSectionName = "GSM Set";
    static constexpr LogCode kLogCodes[] = {code::kNeighborRanking};

    using Section::Section;
    void updateWithData(ByteView data, LogCode logCode) override;
};

}  // namespace kelvo
