#pragma once

#include <array>

#include "LogGenerator/Base.h"

namespace kelvo {

/// The UMTS cells that the phone is connected through.
class ActiveSet final : public Section<ActiveSet> {
public:
    static constexpr std::string_view kSectionName = "Active Set";
    static constexpr std::array<LogCode, 1> kLogCodes = {0x417a};

    using Section::Section;
    void updateWithData(ByteView data, LogCode logCode) override;

private:
    void showActiveCells(ByteView data, std::size_t count) const;
};

}  // namespace kelvo
