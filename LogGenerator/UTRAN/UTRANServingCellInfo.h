#pragma once

#include <array>

#include "LogGenerator/Base.h"

namespace kelvo {

/// The serving cell: identity, frequencies and who may use it. Its two records share keys; the later one shows.
class UTRANServingCellInfo final : public Section<UTRANServingCellInfo> {
public:
    static constexpr std::string_view kSectionName = "Serving Cell Info";
    static constexpr std::array<LogCode, 2> kLogCodes = {0xD0E2, 0xFF0001};

    using Section::Section;
    void updateWithData(ByteView data, LogCode logCode) override;

private:
    void showCellArray(ByteView data);
};

}  // namespace kelvo
