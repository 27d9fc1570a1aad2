#pragma once

#include "LogGenerator/OSKLogGenerator2.h"

namespace kelvo {

/// The generator of GSM/UMTS modems: the "OSK_GSM" template filled by the sections of OSK_GSMClassIndex.
class OSK_GSMLogGenerator final : public OSKLogGenerator2 {
public:
    OSK_GSMLogGenerator();
    ~OSK_GSMLogGenerator() override;

    static std::unique_ptr<LogGenerator> generator() { return std::make_unique<OSK_GSMLogGenerator>(); }
};

}  // namespace kelvo
