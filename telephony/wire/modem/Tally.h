#pragma once

#include <array>
#include <cstdint>
#include <string>

namespace kelvo::modem {

/// What a played modem has sent, and what it has spoilt on purpose: the truth that a reader's counts are held against.
/// A record is in one of `whole`, the damaged, `encrypted` and `cutOff`, or has never been sent.
struct Tally {
    std::array<std::uint64_t, 2> whole{};  ///< records as they should be, by SIM
    std::uint64_t flippedBits = 0;         ///< damaged records
    std::uint64_t cutFrames = 0;
    std::uint64_t badEscapes = 0;
    std::uint64_t lyingLengths = 0;
    std::uint64_t encrypted = 0;
    std::uint64_t cutOff = 0;        ///< records that were on their way when it hung up
    std::uint64_t notSent = 0;       ///< records that nobody read in time
    std::uint64_t noise = 0;         ///< frames that are none
    std::uint64_t oversized = 0;     ///< frames beside the records
    std::uint64_t droppedTexts = 0;  ///< that it says it has dropped

    std::uint64_t damaged() const { return flippedBits + cutFrames + badEscapes + lyingLengths; }
};

/// A line for each count that is not zero: "whole 1234".
std::string tallyText(const Tally& tally);

}  // namespace kelvo::modem
