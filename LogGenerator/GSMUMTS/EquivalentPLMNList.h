#pragma once

#include <array>

#include "LogGenerator/Base.h"

namespace kelvo {

/// The networks that count as equivalent to the serving one.
class EquivalentPLMNList final : public Section<EquivalentPLMNList> {
public:
    static constexpr std::string_view kSectionName = "Equivalent PLMN List";
    static constexpr std::array<LogCode, 1> kLogCodes = {0x7150};

    using Section::Section;
    void updateWithData(ByteView data, LogCode logCode) override;
};

}  // namespace kelvo
