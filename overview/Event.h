#pragma once

#include <chrono>
#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

namespace kelvo::overview {

/// Of the records in a capture; live that of the stream, and of the wall clock where events tell when they were.
using Time = std::chrono::sys_time<std::chrono::microseconds>;

/// A fact around an event, before and after it: {"RSRP", "-101.50 dBm", "-92.00 dBm"}. Empty where it was, or is, not
/// known.
struct EventValue {
    std::string name;
    std::string before;
    std::string after;
    bool operator==(const EventValue&) const = default;
};

/// Something that happened, worked out from the values before and after.
struct Event {
    enum class Kind {
        CellFound,    ///< the first serving cell, or one after a while without
        Handover,     ///< another cell serves, in a connected state
        Reselection,  ///< another cell serves, out of one
        Access,       ///< another radio
        Band,
        State,
        Area,
        Registration,
        Reject,
        ContextUp,
        ContextDown,
        ServiceLost,
        ServiceBack,
        ConnectionLost,  ///< to the telephony service; captures have none
        ConnectionBack,
    };
    // What 2,000 events may hold at the very most, whatever a modem says: 6 MB; those of a drive hold 1.5 MB.
    static constexpr std::size_t kMostValues = 8;
    static constexpr std::size_t kLongestText = 128;  ///< bytes; longer texts are cut
    static constexpr std::size_t kLongestValue = 48;  ///< likewise, of each text in `values`

    Time time;
    Kind kind;
    std::string from = {};         ///< empty where nothing was before
    std::string to = {};           ///< likewise
    std::string levelBefore = {};  ///< of a change of cell
    std::string levelAfter = {};   ///< likewise; empty until the new cell's level has come
    std::uint64_t record = 0;      ///< which told of it; 0 where none is known
    /// Level and quality, and of the other facts those that changed, at most `kMostValues`.
    std::vector<EventValue> values = {};
};

/// "handover", "cell found", "context up".
std::string_view nameOf(Event::Kind kind);

}  // namespace kelvo::overview
