#pragma once

#include <chrono>
#include <cstdint>
#include <string>
#include <string_view>

namespace kelvo::overview {

/// The stream's time, of the records in a capture and of their arrival live.
using Time = std::chrono::sys_time<std::chrono::microseconds>;

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
    };
    Time time;
    Kind kind;
    std::string from;          ///< empty where nothing was before
    std::string to;            ///< likewise
    std::string levelBefore;   ///< of a change of cell
    std::string levelAfter;    ///< likewise; empty until the new cell's level has come
    std::uint64_t record = 0;  ///< which told of it; 0 where none is known
};

/// "handover", "cell found", "context up".
std::string_view nameOf(Event::Kind kind);

}  // namespace kelvo::overview
