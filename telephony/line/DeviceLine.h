#pragma once

#include <array>
#include <memory>

#include "platform/host/FdWatcher.h"
#include "platform/host/UniqueFd.h"
#include "telephony/line/ModemLine.h"

namespace kelvo {

/// The diagnostic device of a phone that Linux runs on: a character device that is no terminal. It is switched over to
/// giving its bytes to us, and wraps them (DeviceEnvelope.h).
class DeviceLine final : public ModemLine {
public:
    DeviceLine(std::string path, Listener& listener) : _path(std::move(path)), _listener(listener) {}

    std::string name() const override { return _path; }
    void open() override;
    void send(ByteView frame) override;
    void mute() override { _muted = true; }

private:
    void read();
    void close(const std::string& reason);

    const std::string _path;
    Listener& _listener;
    UniqueFd _device;
    std::unique_ptr<FdWatcher> _watcher;
    bool _muted = false;
    std::array<std::uint8_t, 262'144> _buffer;
};

}  // namespace kelvo
