#pragma once

#include "LogGenerator/Base.h"
#include "LogGenerator/GSMUMTS/GSMUMTSCodes.h"

namespace kelvo {

/// The UMTS cells that the phone is connected through.
class ActiveSet final : public Section<ActiveSet> {
public:
    static constexpr std::string_view kSectionName = "Active Set";
    static constexpr LogCode kLogCodes[] = {code::kUMTSCellSets};

    using Section::Section;
    void updateWithData(ByteView data, LogCode logCode) override;

private:
    void showActiveCells(ByteView data, std::size_t count) const;
};

}  // namespace kelvo
