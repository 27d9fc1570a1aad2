#pragma once

#include <array>
#include <cstdint>
#include <string_view>

#include "platform/values/Bytes.h"

/// The words of the diagnostic port: the first byte of a frame's body, requests that never change, and refusals.
namespace kelvo::wire {

enum class Command : std::uint8_t {
    Version = 0x00,
    Record = 0x10,
    Time = 0x1C,
    ProtocolVersion = 0x1D,
    Subsystem = 0x4B,
    Event = 0x60,
    RecordConfiguration = 0x73,
    Text = 0x79,
    BuildId = 0x7C,
    TextConfiguration = 0x7D,
    CompressedText = 0x92,
    MultiRadio = 0x98,  ///< wraps a body with the subscription that it belongs to
    CompressedText99 = 0x99,
    Trace9C = 0x9C,
    Trace9D = 0x9D,
    EncryptedRecord = 0x9E,
};

/// The first byte of an answer that refuses a request; the request follows behind it.
enum class Refusal : std::uint8_t {
    BadCommand = 0x13,
    BadParameter = 0x14,
    BadLength = 0x15,
    BadMode = 0x18,
    Locked = 0x42,
    Security = 0x47,
    Transaction = 0x94,
};

/// What a first byte of `command` says when it refuses: "bad command"; empty when it is no refusal.
constexpr std::string_view refusalText(std::uint8_t command) {
    switch (static_cast<Refusal>(command)) {
        case Refusal::BadCommand: return "bad command";
        case Refusal::BadParameter: return "bad parameter";
        case Refusal::BadLength: return "bad length";
        case Refusal::BadMode: return "bad mode";
        case Refusal::Locked: return "locked";
        case Refusal::Security: return "security";
        case Refusal::Transaction: return "transaction";
    }
    return {};
}

/// Bodies of requests.
inline constexpr std::array<std::uint8_t, 1> kVersionRequest{0x00};
inline constexpr std::array<std::uint8_t, 1> kBuildIdRequest{0x7C};
inline constexpr std::array<std::uint8_t, 2> kEventsOff{0x60, 0x00};
inline constexpr std::array<std::uint8_t, 8> kRecordsOff{0x73, 0, 0, 0, 0, 0, 0, 0};
inline constexpr std::array<std::uint8_t, 8> kTextsOff{0x7D, 0x05, 0, 0, 0, 0, 0, 0};

/// The version's answer: 0x00, then texts of 11 (date), 8 (time), 11 (release date), 8 (release time) and 8 (target)
/// characters; longer ones go on. A port that echoes gives back what was asked, which is shorter.
inline constexpr std::size_t kShortestVersionAnswer = 47;
inline constexpr std::size_t kTargetNameAt = 39;
inline constexpr std::size_t kTargetNameSize = 8;

/// The build id's answer has its text from here to its end.
inline constexpr std::size_t kBuildIdTextAt = 12;

}  // namespace kelvo::wire
