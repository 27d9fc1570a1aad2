#pragma once

#include "LogGenerator/Base.h"
#include "LogGenerator/GSMUMTS/GSMUMTSCodes.h"
#include "LogGenerator/PhoneServices/PhoneCodes.h"

namespace kelvo {

/// UMTS neighbors, by their rank for cell reselection or as the cell-information array lists them.
class UMTSSet final : public Section<UMTSSet> {
public:
    static constexpr std::string_view kSectionName = "UMTS Set";
    static constexpr LogCode kLogCodes[] = {code::kNeighborRanking, code::kCellArray};

    using Section::Section;
    void updateWithData(ByteView data, LogCode logCode) override;

private:
    void showRanking(ByteView data);
};

}  // namespace kelvo
