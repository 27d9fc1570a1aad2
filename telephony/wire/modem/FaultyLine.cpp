#include "telephony/wire/modem/FaultyLine.h"

#include <algorithm>

#include "telephony/wire/FrameReader.h"
#include "telephony/wire/FrameWriter.h"
#include "telephony/wire/Protocol.h"
#include "telephony/wire/Wrapper.h"

namespace kelvo::modem {
namespace {

constexpr double kDamage = 1.0 / 16;
constexpr double kNoise = 1.0 / 4;
constexpr double kOversized = 1.0 / 256;
constexpr std::size_t kShortestFrame = 3;  // a byte and the checksum, without the end mark

bool isMark(std::uint8_t byte) { return byte == wire::kFrameEnd || byte == wire::kEscape; }

// Whether a frame is one after all: one cut in 65,536 ends in a checksum that is right.
bool isGood(ByteView frame) {
    Bytes bytes{wire::kFrameEnd};  // the first frame of a stream is not judged
    bytes.insert(bytes.end(), frame.begin(), frame.end());
    wire::MutableBytes input(bytes);
    wire::FrameReader reader;
    return reader.next(input).has_value();
}

void replace16(Bytes& body, std::size_t at, std::size_t value) {
    body[at] = static_cast<std::uint8_t>(value);
    body[at + 1] = static_cast<std::uint8_t>(value >> 8);
}

}  // namespace

FaultyLine::FaultyLine(Faults faults, std::uint64_t seed, Tally& tally)
    : _faults(faults), _random(seed), _tally(tally) {}

void FaultyLine::carry(ByteView body, Bytes& to) {
    makeNoise(to);
    wire::appendFrame(
        to, _faults.has(Fault::TwoSims) ? wire::wrap(anySubscription(), body) : Bytes(body.begin(), body.end()));
}

void FaultyLine::carryRecord(Bytes body, std::size_t sim, Bytes& to) {
    makeNoise(to);
    makeOversized(to);
    const bool lies = hits(Fault::LyingLengths, kDamage);
    std::uint64_t* count = &_tally.whole[sim];
    if (_faults.has(Fault::Encrypted)) {
        std::ranges::generate(body, [this] { return static_cast<std::uint8_t>(below(256)); });
        body[0] = static_cast<std::uint8_t>(wire::Command::EncryptedRecord);
        count = &_tally.encrypted;
    } else if (lies) {
        lie(body);
        count = &_tally.lyingLengths;
    }
    Bytes frame =
        wire::frameOf(_faults.has(Fault::TwoSims) ? wire::wrap(static_cast<std::int32_t>(sim) + 1, body) : body);
    if (!lies && hits(Fault::FlippedBits, kDamage)) {
        flipBit(frame);
        count = &_tally.flippedBits;
    } else if (!lies && hits(Fault::CutFrames, kDamage)) {
        cutEnd(frame);
        count = &_tally.cutFrames;
    } else if (!lies && hits(Fault::BadEscapes, kDamage)) {
        spoilEscape(frame);
        count = &_tally.badEscapes;
    }
    ++*count;
    to.insert(to.end(), frame.begin(), frame.end());
}

std::int32_t FaultyLine::anySubscription() {
    static constexpr std::int32_t kNamed[] = {1, 2, 0, -1};
    return kNamed[below(std::size(kNamed))];
}

bool FaultyLine::hits(Fault fault, double chance) { return _faults.has(fault) && _random.chance(chance); }

std::size_t FaultyLine::below(std::size_t count) {
    return static_cast<std::size_t>(_random.between(0, static_cast<int>(count) - 1));
}

std::uint8_t FaultyLine::plainByte() {
    while (true) {
        const auto byte = static_cast<std::uint8_t>(below(256));
        if (!isMark(byte)) return byte;
    }
}

void FaultyLine::makeNoise(Bytes& to) {
    if (!hits(Fault::Noise, kNoise)) return;
    to.insert(to.end(), below(3), wire::kFrameEnd);  // empty frames, which count for nothing
    Bytes noise;
    do {
        noise.resize(1 + below(40));
        std::ranges::generate(noise, [this] { return plainByte(); });
        noise.push_back(wire::kFrameEnd);
    } while (isGood(noise));
    to.insert(to.end(), noise.begin(), noise.end());
    ++_tally.noise;
}

void FaultyLine::makeOversized(Bytes& to) {
    if (!hits(Fault::OversizedFrames, kOversized)) return;
    const std::size_t length = wire::FrameReader::kLongestFrame + 1 + below(9000);
    for (std::size_t i = 0; i < length; ++i) to.push_back(plainByte());
    to.push_back(wire::kFrameEnd);
    ++_tally.oversized;
}

// The outer length, the inner one or both are more or less than there is.
void FaultyLine::lie(Bytes& body) {
    const std::size_t length = body.size() - 4;
    const std::size_t wrong = below(2) == 0 ? length + 1 + below(1000) : below(length);
    const std::size_t which = below(3);
    if (which != 1) replace16(body, 2, wrong);
    if (which != 0) replace16(body, 4, wrong);
}

void FaultyLine::flipBit(Bytes& frame) {
    while (true) {
        const std::size_t at = below(frame.size() - 1);  // not the end mark
        const auto turned = static_cast<std::uint8_t>(frame[at] ^ 1U << below(8));
        const bool escaped = at > 0 && frame[at - 1] == wire::kEscape;
        if (escaped || isMark(frame[at]) || isMark(turned)) continue;
        frame[at] = turned;
        return;
    }
}

void FaultyLine::cutEnd(Bytes& frame) {
    const std::size_t room = frame.size() - 1 - kShortestFrame;
    std::size_t left = kShortestFrame + below(room);
    while (true) {
        Bytes cut(frame.begin(), frame.begin() + static_cast<std::ptrdiff_t>(left));
        if (cut.back() == wire::kEscape) cut.pop_back();  // or it would be a bad escape
        cut.push_back(wire::kFrameEnd);
        if (cut.size() > kShortestFrame && !isGood(cut)) {
            frame = std::move(cut);
            return;
        }
        left = left > kShortestFrame ? left - 1 : kShortestFrame + room - 1;
    }
}

void FaultyLine::spoilEscape(Bytes& frame) {
    std::size_t at = below(frame.size() - 1);
    if (at > 0 && frame[at - 1] == wire::kEscape) --at;  // not into an escape
    frame.insert(frame.begin() + static_cast<std::ptrdiff_t>(at),
                 {wire::kEscape, static_cast<std::uint8_t>(below(64))});
}

}  // namespace kelvo::modem
