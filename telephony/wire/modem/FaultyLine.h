#pragma once

#include "platform/values/Bytes.h"
#include "telephony/simulation/Random.h"
#include "telephony/wire/modem/Faults.h"
#include "telephony/wire/modem/Tally.h"

namespace kelvo::modem {

/// The way from a modem to its port: makes frames of bodies, and damages them as the faults say. Damage keeps to its
/// frame: end marks stay, so that a damaged record costs its reader that record and one count. Nothing but records is
/// ever damaged.
class FaultyLine {
public:
    /// `tally` outlives the line.
    FaultyLine(Faults faults, std::uint64_t seed, Tally& tally);

    /// Appends the frame of an answer, or of another body that is no record, to `to`. Of several SIMs any may be named.
    void carry(ByteView body, Bytes& to);
    /// Appends the frame of a record's body; `sim` is 0 or 1.
    void carryRecord(Bytes body, std::size_t sim, Bytes& to);

private:
    std::int32_t anySubscription();
    bool hits(Fault fault, double chance);
    std::size_t below(std::size_t count);
    std::uint8_t plainByte();
    void makeNoise(Bytes& to);
    void makeOversized(Bytes& to);
    void lie(Bytes& body);
    void flipBit(Bytes& frame);
    void cutEnd(Bytes& frame);
    void spoilEscape(Bytes& frame);

    const Faults _faults;
    simulation::Random _random;
    Tally& _tally;
};

}  // namespace kelvo::modem
