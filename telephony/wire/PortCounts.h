#pragma once

#include <cstdint>

#include "telephony/wire/FrameReader.h"

namespace kelvo::wire {

/// What a diagnostic port has given since the service began, and what of it was lost: whether to trust a screen.
struct PortCounts {
    FrameReader::Counts frames;
    std::uint64_t records = 0;             ///< well-formed ones, of whatever subscription
    std::uint64_t delivered = 0;           ///< records that a client took
    std::uint64_t forNobody = 0;           ///< records that no client had asked for
    std::uint64_t refused = 0;             ///< records in a layout that nobody knows
    std::uint64_t listenedTo = 0;          ///< records asked for to learn the technology alone, for no client either
    std::uint64_t otherSubscriptions = 0;  ///< records of a SIM that is not the chosen one
    std::uint64_t lyingLengths = 0;        ///< records whose lengths do not agree
    std::uint64_t encrypted = 0;
    std::uint64_t textsDropped = 0;  ///< by the modem, as it says
    std::uint64_t passedBy = 0;      ///< frames that are neither records nor an answer that was awaited
    std::uint64_t strange = 0;       ///< wrappers that hold nothing or are of an unknown kind
    std::uint64_t sessions = 0;      ///< how often the port was opened
    std::uint8_t waiting = 0;        ///< records in the modem behind the one that came last
    std::uint8_t mostWaiting = 0;

    std::uint64_t damaged() const { return frames.damaged() + lyingLengths + strange; }
};

}  // namespace kelvo::wire
