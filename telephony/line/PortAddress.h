#pragma once

#include <cstdint>
#include <string>
#include <variant>

#include "platform/values/Result.h"

namespace kelvo {

/// Where a modem's diagnostic port is: "auto", a path, "tcp:HOST:PORT" or "unix:PATH".
struct PortAddress {
    struct Automatic {
        bool operator==(const Automatic&) const = default;
    };
    struct Node {
        std::string path;
        bool operator==(const Node&) const = default;
    };
    struct Tcp {
        std::string host;
        std::uint16_t port = 0;
        bool operator==(const Tcp&) const = default;
    };
    struct Unix {
        std::string path;
        bool operator==(const Unix&) const = default;
    };

    std::variant<Automatic, Node, Tcp, Unix> place;

    /// Reads an address. A TCP source is trusted like the network it comes from: only this machine's own addresses are
    /// taken unless `remote`.
    static Result<PortAddress> parse(const std::string& text, bool remote);
    /// For people: "the modem at /dev/ttyUSB2".
    std::string description() const;
    bool operator==(const PortAddress&) const = default;
};

}  // namespace kelvo
