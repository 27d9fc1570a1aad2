#include "LogGenerator/CDMA/C2KDataRates.h"

#include <array>

#include "LogGenerator/CDMA/C2KStoreDisplayValue.h"
#include "LogGenerator/RecordView.h"
#include "platform/system/Environment.h"

namespace kelvo {

namespace {

constexpr std::size_t kForwardMinimum = 241;
constexpr std::size_t kReverseMinimum = 1750;

// clang-format off
constexpr std::array<std::uint16_t, 56> kForwardBits = {  // that one count is worth, by counter
     128,  256,  512, 1024, 0,
     128,  256,  512, 1024, 0,
     128,  256,  512, 1024, 0,
     128,  256,  512, 1024, 0,
     128,  256,  512, 1024, 0,
     512, 1024, 2048, 0,
     128,  256,  512, 1024, 0,
     512, 1024, 2048, 0,
    1024, 3072, 0,
     512, 1024, 2048, 0,
    4096, 0,
    1024, 3072, 0,
    4096, 0,
    5120, 0,
    5120, 0,
};

constexpr std::array<std::uint16_t, 12> kReverseBits = {  // of a packet, by rate
    128, 256, 512, 768, 1024, 1536, 2048, 3072, 4096, 6144, 8192, 12288,
};

constexpr ShownReal kRate("%.2f", kbps);

/// Where one link keeps its values.
struct Link {
    Key shown, seq, sent, seq1, sent1, seq2, sent2;
};
constexpr Link kForward{"kFLDataRate", "FLDataSeqNum", "FLDataSent",
                        "FLDataSeqNum1", "FLDataSent1", "FLDataSeqNum2", "FLDataSent2"};
constexpr Link kReverse{"kRLDataRate", "RLDataSeqNum", "RLDataSent",
                        "RLDataSeqNum1", "RLDataSent1", "RLDataSeqNum2", "RLDataSent2"};
// clang-format on

std::int64_t forwardBits(RecordView record) {
    std::int64_t bits = 0;
    for (std::size_t i = 0; i < kForwardBits.size(); ++i) bits += record.read(17 + 4 * i, u32) * kForwardBits[i];
    return bits;
}

/// Six blocks of 288 bytes, twelve rates of 24 bytes in each; the first four of a rate's six counters are summed.
std::int64_t reverseBits(RecordView record) {
    std::int64_t bits = 0;
    for (std::size_t block = 0; block < 6; ++block) {
        for (std::size_t rate = 0; rate < kReverseBits.size(); ++rate) {
            const std::size_t at = 18 + 288 * block + 24 * rate;
            std::int64_t packets = 0;
            for (std::size_t j = 0; j < 4; ++j) packets += record.read(at + 4 * j, u32);
            bits += packets * kReverseBits[rate];
        }
    }
    return bits;
}

void showRate(std::int64_t bits, std::int32_t steps, Key shown, const DictionaryRef& lookup) {
    Value rate;
    showReal(rate, static_cast<double>(bits) / (steps * 1024.0), kRate);
    C2KStoreDisplayValue(shown, rate, lookup);
}

void update(const Link& link, std::uint32_t seq, std::int64_t sent, Dictionary& state, const DictionaryRef& lookup) {
    const DictionaryRef extraInfo = state["ExtraInfo"].dictionary();
    const auto note = [&](Key key, std::int64_t value) {
        if (extraInfo) extraInfo->set(key, value);
    };
    const Number* const knownSeq = state[link.seq].number();
    const Number* const knownSent = state[link.sent].number();
    if (knownSeq != nullptr && knownSent != nullptr) {
        const auto previousSeq = static_cast<std::uint32_t>(knownSeq->integer());
        const std::int64_t previousSent = knownSent->integer();
        const auto steps = static_cast<std::int32_t>(seq - previousSeq);
        if (steps >= 1) showRate(sent - previousSent, steps, link.shown, lookup);
        note(link.seq2, previousSeq);
        note(link.sent2, previousSent);
    } else {
        C2KStoreDisplayValue(link.shown, "", lookup);
    }
    state.set(link.seq, std::int64_t{seq});
    state.set(link.sent, sent);
    note(link.seq1, seq);
    note(link.sent1, sent);
}

}  // namespace

void decodeForwardDataRate(ByteView packet, Dictionary& state, const DictionaryRef& lookup) {
    if (packet.size() < kForwardMinimum) {
        logLine(Level::Error, "Log code 0x1192 is %d bytes long but must be at least %ld bytes.", packet.size(),
                kForwardMinimum);
        return;
    }
    const RecordView record(packet);
    update(kForward, static_cast<std::uint32_t>(record.read(13, u32)), forwardBits(record), state, lookup);
}

void decodeReverseDataRate(ByteView packet, Dictionary& state, const DictionaryRef& lookup) {
    if (packet.size() < kReverseMinimum) {
        logLine(Level::Error, "Log code 0x127e is %d bytes long but must be at least %ld bytes.", packet.size(),
                kReverseMinimum);
        return;
    }
    const RecordView record(packet);
    update(kReverse, static_cast<std::uint32_t>(record.read(14, u32)), reverseBits(record), state, lookup);
}

}  // namespace kelvo
