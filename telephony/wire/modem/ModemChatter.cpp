#include "telephony/wire/modem/ModemChatter.h"

#include "telephony/wire/Protocol.h"
#include "telephony/wire/RecordConfiguration.h"
#include "telephony/wire/Wrapper.h"
#include "telephony/wire/modem/ModemAnswers.h"

namespace kelvo::modem {
namespace {

using wire::Command;

// The answer to another request than this one.
Bytes lateAnswer(ByteView request) {
    return request[0] == static_cast<std::uint8_t>(Command::Version) ? ModemAnswers::buildId()
                                                                     : ModemAnswers::version();
}

// The answer that another equipment's mask had.
Bytes lateMask(ByteView request) {
    const auto parsed = wire::parseConfigurationRequest(request);
    const auto asked = parsed ? wire::equipmentOf(parsed->data) : std::nullopt;
    const std::uint32_t other = asked && *asked == 1 ? 4 : 1;
    return wire::configurationAnswer(wire::Operation::SetMask, 0, wire::maskData(wire::LogMask(other, 16)));
}

}  // namespace

Bytes ModemChatter::anything(std::uint8_t command) {
    Bytes body(static_cast<std::size_t>(_random.between(8, 60)));
    for (std::uint8_t& byte : body) byte = static_cast<std::uint8_t>(_random.between(0, 255));
    body[0] = command;
    return body;
}

Bytes ModemChatter::event() {
    Bytes body = anything(static_cast<std::uint8_t>(Command::Event));
    const std::size_t length = body.size() - 3;
    body[1] = static_cast<std::uint8_t>(length);
    body[2] = static_cast<std::uint8_t>(length >> 8);
    return body;
}

Bytes ModemChatter::text() {
    Bytes body = anything(static_cast<std::uint8_t>(Command::Text));
    const int dropped = _random.between(0, 2);
    body[3] = static_cast<std::uint8_t>(dropped);
    _tally.droppedTexts += static_cast<std::uint64_t>(dropped);
    return body;
}

std::vector<Bytes> ModemChatter::before(ByteView request) {
    std::vector<Bytes> bodies{event(),
                              text(),
                              anything(static_cast<std::uint8_t>(Command::CompressedText)),
                              anything(static_cast<std::uint8_t>(Command::CompressedText99)),
                              anything(static_cast<std::uint8_t>(Command::Trace9D)),
                              lateAnswer(request),
                              lateMask(request)};
    for (Bytes& body : bodies) {
        if (_random.chance(0.5)) body = wire::wrap(1, body);
    }
    return bodies;
}

}  // namespace kelvo::modem
