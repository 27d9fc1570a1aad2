#include "model/TrendSeries.h"

#include <algorithm>

namespace kelvo {

namespace {

constexpr std::uint32_t kLongestRun = 64;  // longer ones would keep forgetting from coming close to what is wanted
constexpr std::size_t kMostQuantities = 16;

std::uint64_t difference(std::int64_t from, std::int64_t to) {
    const auto distance = static_cast<std::int64_t>(static_cast<std::uint64_t>(to) - static_cast<std::uint64_t>(from));
    return (static_cast<std::uint64_t>(distance) << 1U) ^ static_cast<std::uint64_t>(distance >> 63);
}

}  // namespace

std::int64_t TrendSeries::stepped(std::int64_t raw, std::uint64_t difference) {
    const std::uint64_t distance = (difference >> 1U) ^ (0 - (difference & 1U));
    return static_cast<std::int64_t>(static_cast<std::uint64_t>(raw) + distance);
}

void TrendSeries::note(std::uint32_t refresh, const Reading& reading, std::uint64_t record) {
    const bool isKnown = record != 0 && record == _record;
    if (refresh < _end || isKnown) return;
    if (isEmpty()) {
        _begin = _end = refresh;
        _steps.clear();
        _first = _last;
    }
    _record = record;
    const bool newQuantity = _quantities.empty() || _quantities[_last.quantity] != reading.quantity;
    if (refresh == _end && !newQuantity && !isEmpty() && reading.raw == _last.raw) {
        ++_end;
        if (++_run == kLongestRun) endRun();
        return;
    }
    endRun();
    if (refresh > _end) put(Step::Silent, refresh - _end);
    if (newQuantity) useQuantity(reading.quantity);
    put(Step::Changed, difference(_last.raw, reading.raw));
    _last.raw = reading.raw;
    _end = refresh + 1;
}

void TrendSeries::endRun() {
    if (_run > 0) put(Step::Same, _run);
    _run = 0;
}

void TrendSeries::useQuantity(const Quantity* quantity) {
    auto at = std::find(_quantities.begin(), _quantities.end(), quantity);
    if (at == _quantities.end()) {
        if (_quantities.size() == kMostQuantities) {  // no value has so many: what was before is let go
            _quantities.clear();
            _steps.clear();
            _begin = _end;
            _first = _last = {};
        }
        at = _quantities.insert(_quantities.end(), quantity);
    }
    _last.quantity = static_cast<std::size_t>(at - _quantities.begin());
    put(Step::Quantified, _last.quantity);
}

// The first byte has the step in its two lowest bits and five bits of the number, every further one seven bits, the
// lowest first; the highest bit says that more follow.
void TrendSeries::put(Step step, std::uint64_t number) {
    constexpr std::uint64_t kMore = 0x80;
    auto byte = static_cast<std::uint64_t>(step) | (number & 0x1FU) << 2U;
    for (number >>= 5U; number != 0; number >>= 7U) {
        append(byte | kMore);
        byte = number & 0x7FU;
    }
    append(byte);
}

// Grows in small parts: many values share little room.
void TrendSeries::append(std::uint64_t byte) {
    constexpr std::size_t kPart = 64;
    if (_steps.size() == _steps.capacity()) _steps.reserve(_steps.size() + kPart);
    _steps.push_back(static_cast<std::uint8_t>(byte));
}

TrendSeries::Step TrendSeries::take(std::size_t& at, std::uint64_t& number) const {
    std::uint8_t byte = _steps[at++];
    const auto step = static_cast<Step>(byte & 3U);
    number = (byte >> 2U) & 0x1FU;
    for (unsigned shift = 5; (byte & 0x80U) != 0; shift += 7) {
        byte = _steps[at++];
        number |= static_cast<std::uint64_t>(byte & 0x7FU) << shift;
    }
    return step;
}

void TrendSeries::forgetBefore(std::uint32_t refresh) {
    std::size_t kept = 0;
    for (std::size_t at = 0; at < _steps.size();) {
        std::uint64_t number = 0;
        const Step step = take(at, number);
        const bool counts = step == Step::Same || step == Step::Silent;
        const auto behind = static_cast<std::uint32_t>(_begin + (counts ? number : step == Step::Changed ? 1 : 0));
        if (behind > refresh) break;
        _begin = behind;
        if (step == Step::Changed) _first.raw = stepped(_first.raw, number);
        if (step == Step::Quantified) _first.quantity = static_cast<std::size_t>(number);
        kept = at;
    }
    _steps.erase(_steps.begin(), _steps.begin() + static_cast<std::ptrdiff_t>(kept));
    if (_steps.capacity() > 2 * _steps.size() + 128) _steps.shrink_to_fit();
}

std::vector<TrendSeries::Sample> TrendSeries::samples() const {
    std::vector<Sample> all;
    State state = _first;
    std::uint32_t refresh = _begin;
    const auto add = [&] { all.push_back({refresh++, state.raw, _quantities[state.quantity]}); };
    for (std::size_t at = 0; at < _steps.size();) {
        std::uint64_t number = 0;
        switch (take(at, number)) {
            case Step::Same:
                for (; number > 0; --number) add();
                break;
            case Step::Changed:
                state.raw = stepped(state.raw, number);
                add();
                break;
            case Step::Silent: refresh += static_cast<std::uint32_t>(number); break;
            case Step::Quantified: state.quantity = static_cast<std::size_t>(number); break;
        }
    }
    for (std::uint32_t left = _run; left > 0; --left) add();
    return all;
}

std::size_t TrendSeries::bytes() const {
    return sizeof *this + _steps.capacity() + _quantities.capacity() * sizeof(void*);
}

}  // namespace kelvo
