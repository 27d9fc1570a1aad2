#pragma once

#include "LogGenerator/Base.h"
#include "LogGenerator/GSMUMTS/GSMUMTSCodes.h"
#include "LogGenerator/PhoneServices/PhoneCodes.h"

namespace kelvo {

/// The network and the areas in which the phone is registered.
class ServingPLMN final : public Section<ServingPLMN> {
public:
    static constexpr std::string_view kSectionName = "Serving PLMN";
    static constexpr LogCode kLogCodes[] = {code::kServingPLMN, code::kRegistration, code::kCellArray};

    using Section::Section;
    void updateWithData(ByteView data, LogCode logCode) override;

private:
    void showServing(ByteView data);
    void showCellArray(ByteView data);
};

}  // namespace kelvo
