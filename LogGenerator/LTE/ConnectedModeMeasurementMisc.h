#pragma once

#include <array>

#include "LogGenerator/Base.h"

namespace kelvo {

/// The serving cell's filtered power and quality in connected mode.
class ConnectedModeMeasurementMisc final : public Section<ConnectedModeMeasurementMisc> {
public:
    static constexpr std::string_view kSectionName = "Connected mode LTE Intra-frequency Measurement";
    static constexpr std::array<LogCode, 1> kLogCodes = {0xB179};

    using Section::Section;
    void updateWithData(ByteView data, LogCode logCode) override;
};

}  // namespace kelvo
