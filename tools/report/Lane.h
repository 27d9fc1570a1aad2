#pragma once

#include <map>
#include <string>
#include <vector>

#include "tools/report/RecordedTime.h"

namespace kelvo::report {

/// What was the case when: one text at a time. Bounded: where texts change faster than a page can show, short segments
/// are put together under the text that lasted longest.
class Lane {
public:
    static constexpr std::size_t kMostSegments = 1500;
    static constexpr std::size_t kMostTexts = 1000;  ///< whose times are told one by one

    struct Segment {
        Elapsed from;
        Elapsed to;
        std::string text;
        bool isBusy = false;  ///< of several texts: `text` is the one of them that lasted longest
        Elapsed longest{0};   ///< how long that was
    };

    /// `at` does not go back; an empty text is nothing told.
    void note(Elapsed at, const std::string& text);
    /// The last text lasts until then.
    void end(Elapsed at);

    const std::vector<Segment>& segments() const { return _segments; }
    /// How long each text was the case.
    const std::map<std::string, Elapsed>& times() const { return _times; }
    /// How often one text followed another.
    std::uint64_t changes() const { return _changes; }

private:
    void close(Elapsed at);
    void thin();
    void putTogether();

    std::vector<Segment> _segments;
    std::map<std::string, Elapsed> _times;
    std::string _text;
    Elapsed _from{0};
    Elapsed _width{1};
    std::uint64_t _changes = 0;
};

}  // namespace kelvo::report
