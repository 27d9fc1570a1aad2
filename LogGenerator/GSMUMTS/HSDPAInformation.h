#pragma once

#include <array>

#include "LogGenerator/Base.h"

namespace kelvo {

/// The HSDPA downlink: carriers, sub-frames and what each hybrid-ARQ process received (3GPP TS 25.214).
class HSDPAInformation final : public Section<HSDPAInformation> {
public:
    static constexpr std::string_view kSectionName = "HSDPA Info";
    static constexpr std::array<LogCode, 1> kLogCodes = {0x4221};

    using Section::Section;
    void updateWithData(ByteView data, LogCode logCode) override;

private:
    void showProcesses(Key key, ByteView data, std::size_t start, std::size_t count);
};

}  // namespace kelvo
