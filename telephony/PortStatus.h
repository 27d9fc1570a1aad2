#pragma once

#include <array>
#include <string>
#include <string_view>

#include "platform/values/Dictionary.h"
#include "telephony/adaptation/AdaptationMeter.h"
#include "telephony/wire/Session.h"

namespace kelvo {

/// One of the counts of a modem's port, as the status has it.
struct PortCounter {
    std::string_view key;    ///< in the answer to "GetStatus", and in JSON
    std::string_view label;  ///< for people
    std::uint64_t (*of)(const wire::PortCounts&);
};

// clang-format off
inline constexpr std::array kPortCounters = {
    PortCounter{"Bytes",              "Bytes",                    [](const wire::PortCounts& c) { return c.frames.bytes; }},
    PortCounter{"Frames",             "Frames",                   [](const wire::PortCounts& c) { return c.frames.frames; }},
    PortCounter{"Records",            "Records",                  [](const wire::PortCounts& c) { return c.records; }},
    PortCounter{"Delivered",          "  delivered",              [](const wire::PortCounts& c) { return c.delivered; }},
    PortCounter{"Refused",            "  refused",              [](const wire::PortCounts& c) { return c.refused; }},
    PortCounter{"ForNobody",          "  for nobody",             [](const wire::PortCounts& c) { return c.forNobody; }},
    PortCounter{"ListenedTo",         "  for the service",        [](const wire::PortCounts& c) { return c.listenedTo; }},
    PortCounter{"OtherSubscriptions", "  of another SIM",         [](const wire::PortCounts& c) { return c.otherSubscriptions; }},
    PortCounter{"BadChecksums",       "Bad checksums",            [](const wire::PortCounts& c) { return c.frames.badChecksums; }},
    PortCounter{"BadEscapes",         "Bad escapes",              [](const wire::PortCounts& c) { return c.frames.badEscapes; }},
    PortCounter{"TooShort",           "Frames too short",         [](const wire::PortCounts& c) { return c.frames.tooShort; }},
    PortCounter{"Oversized",          "Oversized frames",         [](const wire::PortCounts& c) { return c.frames.oversized; }},
    PortCounter{"Unfinished",         "Unfinished frames",        [](const wire::PortCounts& c) { return c.frames.unfinished; }},
    PortCounter{"LyingLengths",       "Lying lengths",            [](const wire::PortCounts& c) { return c.lyingLengths; }},
    PortCounter{"StrangeWrappers",    "Strange wrappers",         [](const wire::PortCounts& c) { return c.strange; }},
    PortCounter{"Encrypted",          "Encrypted frames",         [](const wire::PortCounts& c) { return c.encrypted; }},
    PortCounter{"TextsDropped",       "Texts the modem dropped",  [](const wire::PortCounts& c) { return c.textsDropped; }},
    PortCounter{"PassedBy",           "Frames passed by",         [](const wire::PortCounts& c) { return c.passedBy; }},
    PortCounter{"Waiting",            "Waiting in the modem",     [](const wire::PortCounts& c) { return std::uint64_t{c.waiting}; }},
    PortCounter{"MostWaiting",        "  at most",                [](const wire::PortCounts& c) { return std::uint64_t{c.mostWaiting}; }},
    PortCounter{"Openings",           "Openings of the port",     [](const wire::PortCounts& c) { return c.sessions; }},
};
// clang-format on

/// What is said and counted on a modem's port, and what became of its records; `line` is where it is open, empty while
/// it is not.
DictionaryRef portStatus(const wire::Session& session, const adaptation::AdaptationMeter& meter,
                         const std::string& line);

/// The same for people, with a newline at the end of each line.
std::string portStatusText(const Dictionary& port);

}  // namespace kelvo
