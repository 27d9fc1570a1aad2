#include "telephony/wire/modem/Faults.h"

#include <fmt/format.h>

#include <algorithm>
#include <iterator>

namespace kelvo::modem {
namespace {

// clang-format off
constexpr FaultEntry kFaults[] = {
    {Fault::Noise,           "noise",            "bytes that are no frame, between frames"},
    {Fault::FlippedBits,     "flipped-bits",     "one record in 16 has a bit turned over"},
    {Fault::CutFrames,       "cut-frames",       "one record in 16 lacks its end"},
    {Fault::BadEscapes,      "bad-escapes",      "one record in 16 has an escape that there is not"},
    {Fault::LyingLengths,    "lying-lengths",    "one record in 16 has lengths that are not its own"},
    {Fault::OversizedFrames, "oversized-frames", "now and then a frame longer than any can be"},
    {Fault::Asynchronous,    "asynchronous",     "events, texts, traces and late answers before every answer"},
    {Fault::SlowAnswers,     "slow-answers",     "answers take up to 1.5 seconds, the one about ranges 5.2"},
    {Fault::MissingAnswers,  "missing-answers",  "the first answer to every request is lost"},
    {Fault::BadCommand,      "bad-command",      "ranges and masks are answered with error 0x13"},
    {Fault::BadParameter,    "bad-parameter",    "masks are answered with error 0x14"},
    {Fault::BadLength,       "bad-length",       "masks are answered with error 0x15"},
    {Fault::BadMode,         "bad-mode",         "ranges and masks are answered with error 0x18"},
    {Fault::Locked,          "locked",           "ranges and masks are answered with error 0x42"},
    {Fault::Security,        "security",         "ranges and masks are answered with error 0x47"},
    {Fault::Transaction,     "transaction",      "ranges and masks are answered with error 0x94"},
    {Fault::SmallerRanges,   "smaller-ranges",   "the ranges end before the last records that Kelvo shows"},
    {Fault::SmallerMasks,    "smaller-masks",    "masks end before the last record that is asked for"},
    {Fault::EarlierSession,  "earlier-session",  "streams from the beginning, for a reader that has gone"},
    {Fault::Encrypted,       "encrypted",        "all records are encrypted"},
    {Fault::TwoSims,         "two-sims",         "two SIMs: everything is wrapped, records come of both"},
    {Fault::Clock1980,       "clock-1980",       "its clock has not been set: it begins in 1980"},
    {Fault::HangUp,          "hang-up",          "is unplugged within a frame after 50 to 200 records, and comes back"},
    {Fault::AtPort,          "at-port",          "another port of the modem: sends back what it gets, and ERROR"},
    {Fault::Silent,          "silent",           "another port of the modem: answers nothing"},
    {Fault::Flood,           "flood",            "records come as fast as they are read, not in their time"},
};
// clang-format on

static_assert(std::size(kFaults) == kFaultCount);

}  // namespace

std::span<const FaultEntry> allFaults() { return kFaults; }

Result<Faults> Faults::parse(std::string_view list) {
    Faults faults;
    while (!list.empty()) {
        const std::string_view name = list.substr(0, list.find(','));
        list.remove_prefix(std::min(name.size() + 1, list.size()));
        const auto entry = std::ranges::find(kFaults, name, &FaultEntry::name);
        if (entry == std::end(kFaults)) return Failure{fmt::format("no fault is called \"{}\"", name)};
        faults.add(entry->fault);
    }
    return faults;
}

}  // namespace kelvo::modem
