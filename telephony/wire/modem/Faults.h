#pragma once

#include <bitset>
#include <cstdint>
#include <span>
#include <string_view>

#include "platform/values/Result.h"

namespace kelvo::modem {

/// In what ways a played modem misbehaves; each is known from the field.
enum class Fault {
    Noise,
    FlippedBits,
    CutFrames,
    BadEscapes,
    LyingLengths,
    OversizedFrames,
    Asynchronous,
    SlowAnswers,
    MissingAnswers,
    BadCommand,
    BadParameter,
    BadLength,
    BadMode,
    Locked,
    Security,
    Transaction,
    SmallerRanges,
    SmallerMasks,
    EarlierSession,
    Encrypted,
    TwoSims,
    Clock1980,
    HangUp,
    AtPort,
    Silent,
    Flood,
};
inline constexpr std::size_t kFaultCount = static_cast<std::size_t>(Fault::Flood) + 1;

/// One line of the table of faults.
struct FaultEntry {
    Fault fault;
    std::string_view name;  ///< on the command line
    std::string_view what;  ///< it does, for people
};
/// Every fault, in the order of the enumeration.
std::span<const FaultEntry> allFaults();

/// A choice of faults.
class Faults {
public:
    Faults() = default;
    Faults(std::initializer_list<Fault> faults) {
        for (const Fault fault : faults) add(fault);
    }
    /// Reads names with commas between them; the reason of a failure tells the name that there is not.
    static Result<Faults> parse(std::string_view list);

    void add(Fault fault) { _set.set(static_cast<std::size_t>(fault)); }
    bool has(Fault fault) const { return _set.test(static_cast<std::size_t>(fault)); }

private:
    std::bitset<kFaultCount> _set;
};

}  // namespace kelvo::modem
