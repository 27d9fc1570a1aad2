#pragma once

#include <unordered_map>

#include "LogGenerator/Base.h"
#include "LogGenerator/GSMUMTS/GSMUMTSCodes.h"
#include "LogGenerator/PhoneServices/PhoneCodes.h"

namespace kelvo {

/// GSM neighbors, measured for reselection or as the cell-information array lists them.
class NeighboringCells final : public Section<NeighboringCells> {
public:
    static constexpr std::string_view kSectionName = "Neighboring Cells";
    static constexpr LogCode kLogCodes[] = {code::kGSMReselection, code::kGSMNeighborIdentities, code::kCellArray};

    using Section::Section;
    void updateWithData(ByteView data, LogCode logCode) override;

private:
    void showMeasurements(ByteView data);
    void keepIdentities(ByteView data);

    std::unordered_map<std::int64_t, std::int64_t> arfcnToBsic;  ///< of the last record with identities
};

}  // namespace kelvo
