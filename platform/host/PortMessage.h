#pragma once

#include <chrono>
#include <cstdint>

#include "platform/Bytes.h"

namespace kelvo {

/// What stands before the data of every datagram between two ports, in the machine's byte order: both ends run on it.
struct PortHeader {
    static constexpr std::uint32_t kMagic = 0x314B'4C56;  ///< the format and its version
    enum Kind : std::uint8_t { Message = 1, Reply = 2 };
    enum Flags : std::uint8_t { NoFlags = 0, WantsReply = 1 };

    std::uint32_t magic = kMagic;
    std::uint8_t kind = Message;
    std::uint8_t flags = NoFlags;
    std::uint16_t reserved = 0;
    std::int32_t id = 0;
    std::uint32_t sequence = 0;  ///< the sender counts its requests; a reply carries the number of its request
    std::uint32_t length = 0;    ///< bytes of data that follow: the rest of the datagram
};
static_assert(sizeof(PortHeader) == 20);

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

    const PortHeader& header() const { return _header; }
    ByteView data() const { return _data; }
    const char* problem() const { return _problem; }

private:
    Outcome check(std::size_t received, bool truncated);
    Outcome refuse(const char* problem);

    PortHeader _header;
    Bytes _buffer;  // made at the first read
    ByteView _data;
    const char* _problem = "";
};

}  // namespace kelvo
