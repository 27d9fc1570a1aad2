#pragma once

#include "LogGenerator/OSKLogGenerator2.h"

namespace kelvo {

/// The generator of LTE modems: the "LTE" template filled by the sections of LTEClassIndex.
class LTELogGenerator final : public OSKLogGenerator2 {
public:
    LTELogGenerator();
    ~LTELogGenerator() override;

    static std::unique_ptr<LogGenerator> generator() { return std::make_unique<LTELogGenerator>(); }
};

}  // namespace kelvo
