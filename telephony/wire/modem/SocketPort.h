#pragma once

#include <QLocalServer>
#include <QTcpServer>
#include <cstdint>
#include <filesystem>
#include <memory>

#include "telephony/wire/modem/ModemPort.h"

namespace kelvo::modem {

/// What TCP and Unix sockets have in common: a server, and the one reader that it has let in.
class SocketPort : public ModemPort {
public:
    void unplug() override;
    std::size_t send(ByteView bytes) override;

protected:
    /// Lets a reader in, or turns it away while another is there.
    void welcome(QIODevice* reader);
    virtual void close() = 0;

private:
    void leave();

    QIODevice* _reader = nullptr;  // a child of the server
};

/// Listens on a TCP port of this machine, for programs of this machine alone.
class TcpPort final : public SocketPort {
public:
    /// 0: a port that is free.
    explicit TcpPort(std::uint16_t port);
    ~TcpPort() override { unplug(); }
    Result<void> plugIn() override;
    std::string place() const override;

private:
    void close() override { _server.close(); }

    QTcpServer _server;
    std::uint16_t _port;
};

/// Listens on a Unix socket, which only this user may use. A file that is there is left alone, unless it is a socket on
/// which nobody listens any more.
class UnixPort final : public SocketPort {
public:
    explicit UnixPort(std::filesystem::path path);
    ~UnixPort() override { unplug(); }
    Result<void> plugIn() override;
    std::string place() const override { return "unix:" + _path.string(); }

private:
    void close() override { _server.close(); }

    QLocalServer _server;
    const std::filesystem::path _path;
};

}  // namespace kelvo::modem
