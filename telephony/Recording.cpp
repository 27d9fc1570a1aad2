#include "telephony/Recording.h"

#include "platform/system/Environment.h"

namespace kelvo {

void Recording::append(Technology technology, const CapturePacket& packet) {
    if (!_file && !_capture) return;
    if (const auto written = write(technology, packet); !written) {
        logLine(Level::Error, "The recording ends here: %s", written.error().reason);
        _file.reset();
        _capture.reset();
    }
}

Result<void> Recording::write(Technology technology, const CapturePacket& packet) {
    if (_capture) return _capture->append(packet.time, packet.bytes);
    auto begun = CaptureWriter::create(std::move(*_file), technology);
    _file.reset();
    if (!begun) return begun.error();
    if (auto first = begun->append(packet.time, packet.bytes); !first) return first;
    if (auto appeared = begun->appear(); !appeared) return appeared;
    _capture.emplace(std::move(begun).value());
    return {};
}

}  // namespace kelvo
