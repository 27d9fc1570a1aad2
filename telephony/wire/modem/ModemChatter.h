#pragma once

#include <vector>

#include "platform/values/Bytes.h"
#include "telephony/simulation/Random.h"
#include "telephony/wire/modem/Tally.h"

namespace kelvo::modem {

/// What a modem says beside answers and records, as bodies of frames.
class ModemChatter {
public:
    /// `tally` outlives the chatter.
    ModemChatter(std::uint64_t seed, Tally& tally) : _random(seed), _tally(tally) {}

    Bytes event();
    /// A text message, which may say that others have been dropped.
    Bytes text();
    /// All that may come before the answer to `request` and is not it: an event, a text, texts and traces of other
    /// kinds, and late answers to other requests, some of them in wrappers.
    std::vector<Bytes> before(ByteView request);

private:
    Bytes anything(std::uint8_t command);

    simulation::Random _random;
    Tally& _tally;
};

}  // namespace kelvo::modem
