#include "tools/CapturePackets.h"

namespace kelvo {

Technology technologyOf(const std::string& path, std::optional<Technology> chosen, const CaptureReader& reader) {
    const auto technology = chosen ? chosen : reader.technology();
    if (technology) return *technology;
    throw CommandFailure(path + " has a link type that names no technology; --technology names one");
}

}  // namespace kelvo
