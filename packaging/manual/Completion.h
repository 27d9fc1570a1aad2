#pragma once

#include <string>
#include <vector>

#include "packaging/manual/Description.h"

namespace kelvo::manual {

/// What may stand in a value's place, as its description tells.
struct Choice {
    std::vector<std::string> words;     ///< "gsm", and beginnings, which end with a colon: "tcp:"
    bool files = false;                 ///< names of files
    std::vector<std::string> suffixes;  ///< of files: these alone, without their dot; empty: all
    bool listed = false;                ///< several words with commas between them
};

/// Values that have no list in the command line's description: meanings by the type's name.
struct KnownValues {
    std::vector<std::string> keys;    ///< of "KEY"
    std::vector<std::string> faults;  ///< of "LIST"
};

/// "gsm|lte|auto" are words; FILE, PATH, LINK, OUT.pcap are files, of the kinds that name or text tell.
Choice choiceOf(const Argument& argument, const KnownValues& known);

/// The scripts that complete a program's command line.
std::string bashCompletion(const Description& program, const KnownValues& known);
std::string zshCompletion(const Description& program, const KnownValues& known);
std::string fishCompletion(const Description& program, const KnownValues& known);

}  // namespace kelvo::manual
