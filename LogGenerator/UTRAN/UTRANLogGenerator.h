#pragma once

#include <optional>

#include "LogGenerator/OSKLogGenerator2.h"

namespace kelvo {

/// The generator of UTRAN modems: the sections of UTRANClassIndex fill the first template among the resources whose
/// name contains "UTRAN" in any case. Without such a template it stays half built: it logs nothing and decodes nothing.
class UTRANLogGenerator final : public OSKLogGenerator2 {
public:
    UTRANLogGenerator();

    static std::unique_ptr<LogGenerator> generator() { return std::make_unique<UTRANLogGenerator>(); }

private:
    explicit UTRANLogGenerator(const std::optional<std::string>& templateName);
};

}  // namespace kelvo
