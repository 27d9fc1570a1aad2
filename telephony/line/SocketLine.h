#pragma once

#include <QIODevice>
#include <array>
#include <cstdint>
#include <functional>

#include "platform/system/Lifetime.h"
#include "telephony/line/ModemLine.h"
#include "telephony/line/ReadRest.h"

namespace kelvo {

/// A stream socket behind which a router of the phone offers its diagnostic port: the same frames as on a serial node.
class SocketLine final : public ModemLine {
public:
    /// A line to a TCP port, and one to a Unix socket.
    static std::unique_ptr<ModemLine> toTcp(std::string host, std::uint16_t port, Listener& listener);
    static std::unique_ptr<ModemLine> toUnix(std::string path, Listener& listener);
    ~SocketLine() override;

    std::string name() const override { return _name; }
    void open() override { _connect(); }
    void send(ByteView frame) override;
    void mayGather(bool may) override { _rest.setAllowed(may); }
    void mute() override;

private:
    template <class Socket>
    SocketLine(Socket* socket, std::string name, Listener& listener);
    void read();
    void close(const std::string& reason);

    const std::string _name;
    Listener& _listener;
    QIODevice* const _socket;  // outlives this object by the rest of its own signal
    std::function<void()> _connect;
    ReadRest _rest;
    bool _muted = false;
    std::array<std::uint8_t, 65'536> _buffer;
    const Lifetime _lifetime;
};

}  // namespace kelvo
