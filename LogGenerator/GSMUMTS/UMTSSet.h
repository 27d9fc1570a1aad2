#pragma once

#include <array>

#include "LogGenerator/Base.h"

namespace kelvo {

/// UMTS neighbors, by their rank for cell reselection or as the cell-information array lists them.
class UMTSSet final : public Section<UMTSSet> {
public:
    static constexpr std::string_view kSectionName = "UMTS Set";
    static constexpr std::array<LogCode, 2> kLogCodes = {0x4005, 0xff0001};

    using Section::Section;
    void updateWithData(ByteView data, LogCode logCode) override;

private:
    void showRanking(ByteView data);
    void showCellArray(ByteView data);
};

}  // namespace kelvo
