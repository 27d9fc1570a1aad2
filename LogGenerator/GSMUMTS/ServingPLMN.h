#pragma once

#include <array>

#include "LogGenerator/Base.h"

namespace kelvo {

/// The network and the areas in which the phone is registered.
class ServingPLMN final : public Section<ServingPLMN> {
public:
    static constexpr std::string_view kSectionName = "Serving PLMN";
    static constexpr std::array<LogCode, 3> kLogCodes = {0x7135, 0x7132, 0xff0001};

    using Section::Section;
    void updateWithData(ByteView data, LogCode logCode) override;

private:
    void showServing(ByteView data);
    void showCellArray(ByteView data);
};

}  // namespace kelvo
