#pragma once

#include <string>
#include <vector>

namespace CLI {
class App;
}

namespace kelvo::manual {

/// An option, or an argument that stands for itself.
struct Argument {
    std::vector<std::string> names;  ///< "-o", "--output"; of a positional argument its name alone: "FILE"
    std::string type;                ///< of its value: "OUT.pcap", "gsm|lte|auto"; empty: it takes none
    std::string text;                ///< what `--help` says of it, in one line
    std::string initial;             ///< the value without it; empty: none
    bool valueIsOptional = false;
    bool isRequired = false;
    bool repeats = false;
    std::vector<std::string> needs;     ///< options, by their names
    std::vector<std::string> excludes;  ///< options, by their names
};

/// A program, or one of its commands, as its command line describes it.
struct Description {
    std::string name;  ///< "kelvoctl decode"
    std::string text;
    std::vector<Argument> options;
    std::vector<Argument> positionals;
    std::string footer;
    std::vector<Description> commands;
};

Description describe(const CLI::App& app);

/// What stands between blanks or `separator`s.
std::vector<std::string> split(const std::string& text, char separator);

}  // namespace kelvo::manual
