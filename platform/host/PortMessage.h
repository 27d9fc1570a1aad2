#pragma once

#include <chrono>
#include <string>

#include "platform/host/PortDatagram.h"
#include "platform/values/Bytes.h"

namespace kelvo {

enum class PortSent { Sent, WouldBlock, Gone };

/// Sends one datagram and never blocks; `data` is at most kMaxMessageSize long. A peer that is gone raises no signal.
PortSent sendPortMessage(int fd, PortHeader header, ByteView data);

/// Waits until `fd` is ready for `events` (as poll names them) or hung up; false when `deadline` passed first.
bool waitForPort(int fd, short events, std::chrono::steady_clock::time_point deadline);

/// True while the other end of the connection is open.
bool isPeerThere(int fd);

/// Reads datagrams and checks their form. Holds the one it read last.
class PortReader {
public:
    enum class Outcome {
        Message,  ///< header() and data() are valid until the next read
        Nothing,  ///< no datagram waits
        Garbage,  ///< one was dropped: problem() says why
        Closed,   ///< the peer is gone and everything it sent has been read
    };

    /// Takes one datagram off the socket; never blocks.
    Outcome read(int fd);

    const PortHeader& header() const { return _datagram.header; }
    ByteView data() const { return _datagram.data; }
    const std::string& problem() const { return _problem; }

private:
    Outcome check(std::size_t received);
    Outcome refuse(std::string problem);

    Bytes _buffer;  // made at the first read
    PortDatagram _datagram;
    std::string _problem;
};

}  // namespace kelvo
