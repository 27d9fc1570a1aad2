#include "packaging/manual/Completion.h"

#include <algorithm>
#include <cctype>

namespace kelvo::manual {
namespace {

bool isPlaceholder(const std::string& word) {
    return std::any_of(word.begin(), word.end(), [](unsigned char c) { return std::isupper(c) != 0; });
}

bool namesFile(const std::string& word) {
    for (const char* file : {"FILE", "PATH", "LINK", "OUT"}) {
        if (word.find(file) != word.npos) return true;
    }
    return word.find('.') != word.npos;
}

std::vector<std::string> kindsIn(const std::string& text) {
    struct Kind {
        const char* suffix;
        std::vector<const char*> signs;
    };
    std::vector<std::string> suffixes;
    for (const Kind& kind : {Kind{"pcap", {"pcap", "capture"}}, Kind{"kelvo", {"kelvo", "snapshot"}},
                             Kind{"frames", {"*.frames", ".frames"}}, Kind{"dlf", {"DLF", ".dlf"}}}) {
        const auto isIn = [&](const char* sign) { return text.find(sign) != text.npos; };
        if (std::any_of(kind.signs.begin(), kind.signs.end(), isIn)) suffixes.emplace_back(kind.suffix);
    }
    return suffixes;
}

}  // namespace

Choice choiceOf(const Argument& argument, const KnownValues& known) {
    Choice choice;
    if (argument.type == "KEY") choice.words = known.keys;
    if (argument.type == "LIST") {
        choice.words = known.faults;
        choice.listed = true;
    }
    if (argument.type.empty() || !choice.words.empty()) return choice;
    for (const std::string& word : split(argument.type, '|')) {
        if (!isPlaceholder(word)) {
            choice.words.push_back(word);
        } else if (word.find(':') != word.npos) {
            choice.words.push_back(word.substr(0, word.find(':') + 1));
        } else if (namesFile(word)) {
            choice.files = true;
            const std::size_t dot = word.find('.');
            choice.suffixes = dot != word.npos ? std::vector{word.substr(dot + 1)} : kindsIn(argument.text);
        }
    }
    return choice;
}

}  // namespace kelvo::manual
