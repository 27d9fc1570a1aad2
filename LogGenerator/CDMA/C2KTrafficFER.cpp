#include "LogGenerator/CDMA/C2KTrafficFER.h"

#include "LogGenerator/CDMA/C2KFindSubpacket.h"
#include "LogGenerator/CDMA/C2KStoreDisplayValue.h"
#include "LogGenerator/RecordView.h"
#include "platform/system/Environment.h"

namespace kelvo {

namespace {

constexpr std::size_t kMinimum = 17;
constexpr Key kTrafficFER("TrafficFER");
constexpr Key kShownKey("k1xTrafficFER");
constexpr ShownReal kRate("%.02f", percent);
constexpr ShownReal kOldRate("%.02f (old)", percent);

/// In single precision, as the filter has always run: one frame in 64 counts.
float filtered(bool erased, const Number* previous) {
    float rate = (erased ? 1.0F : 0.0F) * 0.015625F;
    if (previous != nullptr) rate += 0.984375F * static_cast<float>(previous->real());
    return rate;
}

/// The percentage is only shown: it is computed in double precision, in which it is printed anyway.
void show(const ShownReal& quantity, double rate, const DictionaryRef& lookup) {
    Value shown;
    showReal(shown, 100 * rate, quantity);
    C2KStoreDisplayValue(kShownKey, shown, lookup);
}

}  // namespace

void decodeTrafficFER(ByteView packet, Dictionary& state, const DictionaryRef& lookup) {
    if (packet.size() < kMinimum) {
        logLine(Level::Error, "Log code 0x119d is %d bytes long but must be at least %ld bytes.", packet.size(),
                kMinimum);
        return;
    }
    const auto demodulation = C2KFindSubpacket(packet, 11);
    if (!demodulation) {
        logLine(Level::Warning, "Log code 0x119d: missing traffic demod subpacket.");
        return;
    }
    const bool erased = RecordView(packet).read(*demodulation + 24, u8) != 0;
    const double rate = filtered(erased, state[kTrafficFER].number());
    state.set(kTrafficFER, rate);
    show(kRate, rate, lookup);
}

void endTrafficFER(Dictionary& state, const DictionaryRef& lookup) {
    const Number* rate = state[kTrafficFER].number();
    if (rate == nullptr) return;
    show(kOldRate, rate->real(), lookup);
    state.remove(kTrafficFER);
}

}  // namespace kelvo
