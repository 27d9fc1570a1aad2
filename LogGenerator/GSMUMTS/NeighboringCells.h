#pragma once

#include <array>
#include <unordered_map>

#include "LogGenerator/Base.h"

namespace kelvo {

/// GSM neighbors, measured (0x5137) or as the cell-information array lists them.
class NeighboringCells final : public Section<NeighboringCells> {
public:
    static constexpr std::string_view kSectionName = "Neighboring Cells";
    static constexpr std::array<LogCode, 3> kLogCodes = {0x5137, 0x51ff, 0xff0001};

    using Section::Section;
    void updateWithData(ByteView data, LogCode logCode) override;

private:
    void showMeasurements(ByteView data);
    void keepIdentities(ByteView data);
    void showCellArray(ByteView data);

    std::unordered_map<std::int64_t, std::int64_t> arfcnToBsic;  ///< of the last 0x51ff record
};

}  // namespace kelvo
