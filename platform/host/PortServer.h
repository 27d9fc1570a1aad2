#pragma once

#include <QTimer>
#include <cstdint>
#include <map>
#include <memory>
#include <string>

#include "platform/host/FdWatcher.h"
#include "platform/host/PortMessage.h"
#include "platform/host/PortSocket.h"
#include "platform/system/MessagePorts.h"

namespace kelvo {

/// What works behind a local port: accepts senders, reads their messages, sends the replies. It is shared with the
/// delivery that is running, so that a message's callback may close or destroy the port.
/// One turn of the event loop takes a bounded number of messages, an equal share from every sender, in bounded time.
class PortServer : public std::enable_shared_from_this<PortServer> {
public:
    PortServer(PortClaim claim, std::string name, MessageCallback callback);

    const std::string& name() const { return _name; }
    bool isOpen() const { return _claim != nullptr; }
    void start();
    void close();

private:
    struct Connection {
        UniqueFd fd;
        std::unique_ptr<FdWatcher> watcher;  // goes before the descriptor
        bool lostReply = false;
    };

    void accept();
    void admit(UniqueFd fd);
    void pauseAccepting();
    void receive(int fd);
    void rest(int fd);
    bool receiveOne(int fd);
    void answer(int fd, const PortHeader& request, ByteView reply);

    std::unique_ptr<PortClaim> _claim;  // none once closed
    const std::string _name;
    const MessageCallback _callback;
    std::unique_ptr<FdWatcher> _acceptor;
    QTimer _acceptAgain;
    QTimer _rest;
    std::map<int, Connection> _connections;  // by descriptor
    PortReader _reader;
    bool _delivering = false;
    bool _toldFull = false;
    bool _toldNoDescriptors = false;
};

}  // namespace kelvo
