#pragma once

#include "LogGenerator/Base.h"
#include "LogGenerator/LTE/LTECodes.h"

namespace kelvo {

/// The serving cell's filtered power and quality in connected mode.
class ConnectedModeMeasurementMisc final : public Section<ConnectedModeMeasurementMisc> {
public:
    static constexpr std::string_view kSectionName = "Connected mode LTE Intra-frequency Measurement";
    static constexpr LogCode kLogCodes[] = {code::kLTEIntraFrequency};

    using Section::Section;
    void updateWithData(ByteView data, LogCode logCode) override;
};

}  // namespace kelvo
