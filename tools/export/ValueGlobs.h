#pragma once

#include <string>
#include <string_view>
#include <vector>

#include "platform/values/Result.h"

namespace kelvo {

/// Which paths the user wants: those that one of the globs matches, or all when there is none. In a glob * stands for
/// any text, also across "/", ? for one byte and [a-z] for one of several; capitals do not matter.
class ValueGlobs {
public:
    /// `words`: globs, whole paths, and the short names signal, cell, neighbours, registration and throughput. A word
    /// that is none of them is a failure.
    static Result<ValueGlobs> of(const std::vector<std::string>& words);

    bool want(const std::string& path);
    /// The words that no path has matched so far.
    std::vector<std::string> unmatched() const;
    /// The paths, when every word is one and not a pattern; else none.
    std::vector<std::string> wholePaths() const;

private:
    struct Word {
        std::string text;
        std::vector<std::string> globs;
        bool hasMatched = false;
    };
    std::vector<Word> _words;
};

}  // namespace kelvo
