#pragma once

#include "LogGenerator/Base.h"
#include "LogGenerator/GSMUMTS/GSMUMTSCodes.h"

namespace kelvo {

/// The HSDPA downlink: carriers, sub-frames and what each hybrid-ARQ process received (3GPP TS 25.214).
class HSDPAInformation final : public Section<HSDPAInformation> {
public:
    static constexpr std::string_view kSectionName = "HSDPA Info";
    static constexpr LogCode kLogCodes[] = {code::kHSDPA};

    using Section::Section;
    void updateWithData(ByteView data, LogCode logCode) override;

private:
    void showProcesses(Key key, ByteView data, std::size_t start, std::size_t count);
};

}  // namespace kelvo
