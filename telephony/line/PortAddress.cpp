#include "telephony/line/PortAddress.h"

#include <fmt/format.h>

#include <QHostAddress>

#include "platform/encodings/WholeNumber.h"

namespace kelvo {
namespace {

constexpr std::string_view kTcp = "tcp:";
constexpr std::string_view kUnix = "unix:";

bool isThisMachine(const std::string& host) {
    return host == "localhost" || QHostAddress(QString::fromStdString(host)).isLoopback();
}

// HOST:PORT; an IPv6 address may stand in brackets.
Result<PortAddress> parseTcp(const std::string& text, bool remote) {
    const std::size_t colon = text.rfind(':');
    std::string host = text.substr(0, colon);
    const auto port = wholeNumber(colon == std::string::npos ? "" : text.substr(colon + 1));
    if (host.size() > 2 && host.front() == '[' && host.back() == ']') host = host.substr(1, host.size() - 2);
    if (host.empty() || !port || *port == 0 || *port > 65'535)
        return Failure{fmt::format("tcp:{} is not tcp:HOST:PORT", text)};
    if (!remote && !isThisMachine(host))
        return Failure{
            fmt::format("{} is not this machine; whoever is in between could make the screens up "
                        "(--allow-remote permits it)",
                        host)};
    return PortAddress{PortAddress::Tcp{host, static_cast<std::uint16_t>(*port)}};
}

template <class... Kinds>
struct Overloaded : Kinds... {
    using Kinds::operator()...;
};
template <class... Kinds>
Overloaded(Kinds...) -> Overloaded<Kinds...>;

}  // namespace

Result<PortAddress> PortAddress::parse(const std::string& text, bool remote) {
    if (text == "auto") return PortAddress{Automatic{}};
    if (text.starts_with(kTcp)) return parseTcp(text.substr(kTcp.size()), remote);
    if (text.starts_with(kUnix)) {
        if (text.size() == kUnix.size()) return Failure{"unix: lacks its path"};
        return PortAddress{Unix{text.substr(kUnix.size())}};
    }
    if (text.empty()) return Failure{"there is no port without a name"};
    return PortAddress{Node{text}};
}

std::string PortAddress::description() const {
    return std::visit(
        Overloaded{[](const Automatic&) { return std::string("the modem that is plugged in"); },
                   [](const Node& node) { return "the modem at " + node.path; },
                   [](const Tcp& tcp) { return fmt::format("the modem at tcp:{}:{}", tcp.host, tcp.port); },
                   [](const Unix& socket) { return "the modem at unix:" + socket.path; }},
        place);
}

}  // namespace kelvo
