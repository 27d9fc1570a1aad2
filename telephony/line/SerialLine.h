#pragma once

#include <QSerialPort>
#include <array>

#include "platform/system/Lifetime.h"
#include "telephony/line/ModemLine.h"
#include "telephony/line/ReadRest.h"

namespace kelvo {

/// A serial node, opened for us alone and never as the controlling terminal: raw, 8N1, 115,200.
class SerialLine final : public ModemLine {
public:
    struct Options {
        bool controlLines = true;  ///< RTS and DTR are on
    };

    SerialLine(std::string path, Options options, Listener& listener);
    ~SerialLine() override;

    std::string name() const override { return _path; }
    void open() override;
    void send(ByteView frame) override;
    void mayGather(bool may) override { _rest.setAllowed(may); }
    void mute() override;

private:
    void read();
    void close(const std::string& reason);

    const std::string _path;
    const Options _options;
    Listener& _listener;
    QSerialPort* const _port;  // outlives this object by the rest of its own signal
    ReadRest _rest;
    bool _muted = false;
    std::array<std::uint8_t, 65'536> _buffer;
    const Lifetime _lifetime;
};

}  // namespace kelvo
