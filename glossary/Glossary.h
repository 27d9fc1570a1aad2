#pragma once

#include <span>
#include <string_view>
#include <vector>

#include "platform/telephony/Technology.h"

/// What the values on the screens mean, in the field's terms: the one source of `kelvoctl explain`, of docs/values.md
/// and of a value's details.
namespace kelvo {

/// What stands behind one key of the screens.
struct Meaning {
    std::string_view section;   ///< the screen or list in which the key means this; empty: wherever the family has it
    std::string_view key;       ///< as the screens write it
    std::string_view sentence;  ///< one, with its full stop
    std::string_view standard;  ///< "3GPP TS 36.304, 5.2.3.2"; empty for what is the modem's own
};

/// A family's meanings, in the order of its screens; what all phones tell (SIM, data contexts) comes last.
std::vector<Meaning> meaningsOf(Technology technology);

/// The meaning of the value at `path`, "/Neighbor Cells List/0/Srxlev", as the display tree has it; null when there is
/// none. A row of a list without keys, and one whose key is a number, means what its list does.
const Meaning* meaningAt(Technology technology, std::string_view path);

/// What stands for a standard in texts: "no standard, the modem's own" where there is none.
std::string_view standardOf(const Meaning& meaning);

/// The families' tables, a file each.
namespace glossary {
extern const std::span<const Meaning> kCDMA;
extern const std::span<const Meaning> kGSM;
extern const std::span<const Meaning> kIFX;
extern const std::span<const Meaning> kLTE;
extern const std::span<const Meaning> kUTRAN;
extern const std::span<const Meaning> kSim;           ///< LTE, GSM/UMTS and UTRAN
extern const std::span<const Meaning> kDataContexts;  ///< likewise
}  // namespace glossary

}  // namespace kelvo
