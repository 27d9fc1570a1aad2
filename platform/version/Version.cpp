#include "platform/version/Version.h"

#include <KelvoBuild.h>  // made by each build

namespace kelvo {

std::string_view version() { return KELVO_VERSION; }

std::string versionLine(std::string_view program) {
    return std::string(program) + " " KELVO_VERSION " (commit " KELVO_COMMIT ", " KELVO_BUILD ")";
}

}  // namespace kelvo
