#pragma once

#include "LogGenerator/Base.h"
#include "LogGenerator/PhoneServices/PhoneCodes.h"
#include "LogGenerator/UTRAN/UTRANCodes.h"

namespace kelvo {

/// The serving cell: identity, frequencies and who may use it. Its two records share keys; the later one shows.
class UTRANServingCellInfo final : public Section<UTRANServingCellInfo> {
public:
    static constexpr std::string_view kSectionName = "Serving Cell Info";
    static constexpr LogCode kLogCodes[] = {code::kUTRANServingCell, code::kCellArray};

    using Section::Section;
    void updateWithData(ByteView data, LogCode logCode) override;

private:
    void showCellArray(ByteView data);
};

}  // namespace kelvo
