#pragma once

#include "LogGenerator/Base.h"
#include "LogGenerator/UTRAN/UTRANCodes.h"

namespace kelvo {

/// Block error rates of the transport channels, one row a channel.
class TRCHBLERMeasurement final : public Section<TRCHBLERMeasurement> {
public:
    static constexpr std::string_view kSectionName = "TRCH BLER";
    static constexpr LogCode kLogCodes[] = {code::kUTRANTransportChannels};

    using Section::Section;
    void updateWithData(ByteView data, LogCode logCode) override;
};

}  // namespace kelvo
