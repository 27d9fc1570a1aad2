#include "telephony/wire/CampedTechnology.h"

#include <algorithm>

namespace kelvo::wire {
namespace {

using namespace std::chrono_literals;

constexpr auto kShortestListening = 500ms;
constexpr auto kLongestListening = 3s;
constexpr auto kInterval = 5s;  // in which a technology must have been silent to count as left

struct Sign {
    LogCode code;
    Technology technology;
};

// clang-format off
constexpr Sign kSigns[] = {
    {0xB0C1, Technology::LTE},    // master information block
    {0xB0C2, Technology::LTE},    // serving cell
    {0xB179, Technology::LTE},    // measurements while connected
    {0xB17F, Technology::LTE},    // serving cell's measurements
    {0xB193, Technology::LTE},    // the same of newer modems
    {0xD00A, Technology::UTRAN},  // measurements
    {0xD0E0, Technology::UTRAN},  // state of the radio resource control
    {0xD0E2, Technology::UTRAN},  // serving cell
    {0x4005, Technology::GSM},    // UMTS: searcher
    {0x4125, Technology::GSM},    // UMTS: state of the radio resource control
    {0x4127, Technology::GSM},    // UMTS: serving cell
    {0x5072, Technology::GSM},    // GSM: power
    {0x5134, Technology::GSM},    // GSM: serving cell
    {0x5137, Technology::GSM},    // GSM: measurements
    {0x1183, Technology::CDMA},   // EV-DO: status
    {0x119C, Technology::CDMA},   // 1x: status
    {0x12B6, Technology::CDMA},   // EV-DO: pilots
    {0x134F, Technology::CDMA},   // 1x: system
};
// clang-format on

// What a modem that says nothing is taken for: by its equipment, the newest first.
std::optional<Technology> technologyBy(const Ranges& ranges) {
    if (ranges[0xB] != 0) return Technology::LTE;
    if (ranges[0x4] != 0 || ranges[0x5] != 0) return Technology::GSM;
    if (ranges[0xD] != 0) return Technology::UTRAN;
    if (ranges[0x1] != 0) return Technology::CDMA;
    return std::nullopt;
}

}  // namespace

const RecordCodes& CampedTechnology::codes() {
    static const RecordCodes codes = [] {
        RecordCodes all;
        for (const Sign& sign : kSigns) all.set(sign.code);
        return all;
    }();
    return codes;
}

std::optional<Technology> CampedTechnology::technologyOf(LogCode code) {
    const Sign* const sign = std::ranges::find(kSigns, code, &Sign::code);
    return sign != std::end(kSigns) ? std::optional(sign->technology) : std::nullopt;
}

void CampedTechnology::begin(nanoseconds now) {
    _began = now;
    _heard = {};
}

void CampedTechnology::forget() { *this = {}; }

void CampedTechnology::heard(LogCode code, nanoseconds now) {
    if (!_began) return;
    const auto technology = technologyOf(code);
    if (!technology) return;
    // The other's first sign may be its last for a while: the interval in which the old one must be silent begins here.
    if (_known && *technology != *_known && now >= *_began + kInterval) begin(now);
    ++_heard[static_cast<std::size_t>(*technology)];
}

bool CampedTechnology::settle(const Ranges& ranges, nanoseconds now) {
    if (!_began) return false;
    const nanoseconds passed = now - *_began;
    if (_known) return passed >= kInterval && conclude(mostHeard(), now);
    const auto most = mostHeard();
    if (most && passed >= kShortestListening) return conclude(most, now);
    return passed >= kLongestListening && conclude(technologyBy(ranges), now);
}

std::optional<std::chrono::nanoseconds> CampedTechnology::deadline() const {
    if (!_began) return std::nullopt;
    if (!_known) return *_began + (mostHeard() ? nanoseconds(kShortestListening) : nanoseconds(kLongestListening));
    const auto most = mostHeard();
    return most && most != _known ? std::optional(*_began + kInterval) : std::nullopt;
}

// While one is known, only its silence makes room for another.
std::optional<Technology> CampedTechnology::mostHeard() const {
    if (_known && _heard[static_cast<std::size_t>(*_known)] > 0) return _known;
    const auto most = std::ranges::max_element(_heard);
    if (*most == 0) return std::nullopt;
    return static_cast<Technology>(most - _heard.begin());
}

bool CampedTechnology::conclude(std::optional<Technology> technology, nanoseconds now) {
    begin(now);
    if (!technology || technology == _known) return false;
    _known = technology;
    return true;
}

}  // namespace kelvo::wire
