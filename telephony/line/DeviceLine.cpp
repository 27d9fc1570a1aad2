#include "telephony/line/DeviceLine.h"

#include <fcntl.h>
#include <sys/ioctl.h>
#include <unistd.h>

#include <cerrno>
#include <system_error>

#include "telephony/line/DeviceEnvelope.h"

namespace kelvo {
namespace {

constexpr unsigned long kSwitchMode = 7;
constexpr unsigned long kBytesToUs = 2;

std::string errorText() { return std::generic_category().message(errno); }

}  // namespace

void DeviceLine::open() {
    _device = UniqueFd(::open(_path.c_str(), O_RDWR | O_NONBLOCK | O_NOCTTY | O_CLOEXEC));
    if (!_device) return _listener.lineClosed(errorText());
    if (::ioctl(_device.get(), kSwitchMode, kBytesToUs) < 0) return close(errorText());
    _watcher = std::make_unique<FdWatcher>(_device.get(), FdWatcher::For::Reading, [this] { read(); });
    _listener.lineOpened();
}

void DeviceLine::send(ByteView frame) {
    const Bytes wrapped = DeviceEnvelope::wrap(frame);
    // A device that takes no request gives no answer either: the session notices.
    if (_device && ::write(_device.get(), wrapped.data(), wrapped.size()) < 0 && errno != EAGAIN) close(errorText());
}

void DeviceLine::read() {
    if (_muted) return;
    const ssize_t size = ::read(_device.get(), _buffer.data(), _buffer.size());
    if (size > 0) {
        // What is no envelope is nothing that could be read: frames in it would not be whole.
        DeviceEnvelope::unwrap(std::span(_buffer).first(static_cast<std::size_t>(size)),
                               [this](std::span<std::uint8_t> piece) {
                                   if (!_muted) _listener.lineGave(piece);
                               });
    } else if (size == 0) {
        close("it hung up");
    } else if (errno != EAGAIN && errno != EINTR) {
        close(errorText());
    }
}

void DeviceLine::close(const std::string& reason) {
    if (std::exchange(_muted, true)) return;
    _watcher.reset();
    _listener.lineClosed(reason);
}

}  // namespace kelvo
