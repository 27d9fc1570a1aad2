#include "tools/report/Lane.h"

#include <utility>

namespace kelvo::report {

void Lane::note(Elapsed at, const std::string& text) {
    if (text == _text) return;
    if (!_text.empty() && !text.empty()) ++_changes;
    close(at);
    _text = text;
    _from = at;
}

void Lane::end(Elapsed at) {
    close(at);
    _text.clear();
    if (_width > Elapsed(1)) putTogether();
}

void Lane::close(Elapsed at) {
    if (_text.empty()) return;
    if (const auto known = _times.find(_text); known != _times.end()) {
        known->second += at - _from;
    } else if (_times.size() < kMostTexts) {
        _times.emplace(_text, at - _from);
    }
    _segments.push_back({_from, at, _text, false, at - _from});
    if (_segments.size() > kMostSegments) thin();
}

void Lane::thin() {
    putTogether();
    while (_segments.size() > kMostSegments / 2) {
        _width *= 2;
        putTogether();
    }
}

/// A segment joins the one before as long as that is shorter than a step, and so is it itself.
void Lane::putTogether() {
    std::vector<Segment> fewer;
    for (Segment& segment : _segments) {
        const auto isShort = [&](const Segment& one) { return one.to - one.from < _width; };
        const bool joins =
            !fewer.empty() && isShort(segment) && isShort(fewer.back()) && segment.to - fewer.back().from <= _width;
        if (!joins) {
            fewer.push_back(std::move(segment));
            continue;
        }
        Segment& last = fewer.back();
        last.to = segment.to;
        last.isBusy = last.isBusy || segment.isBusy || last.text != segment.text;
        if (segment.longest > last.longest) {
            last.longest = segment.longest;
            last.text = std::move(segment.text);
        }
    }
    _segments = std::move(fewer);
}

}  // namespace kelvo::report
