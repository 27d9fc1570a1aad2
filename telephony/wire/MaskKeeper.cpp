#include "telephony/wire/MaskKeeper.h"

namespace kelvo::wire {

void MaskKeeper::begin(const Ranges& ranges) {
    _ranges = ranges;
    _told.reset();
    for (std::uint32_t id = 0; id < kEquipmentIds; ++id) _asked[id] = LogMask(id, ranges[id]);
}

std::vector<LogCode> MaskKeeper::takeUnknown() {
    std::vector<LogCode> codes;
    for (LogCode code = 0; code < _wanted.size(); ++code) {
        if (_wanted.test(code) && !has(code)) tellOnce(code, codes);
    }
    return codes;
}

std::optional<LogMask> MaskKeeper::takeNext() {
    for (std::uint32_t id = 0; id < kEquipmentIds; ++id) {
        LogMask wanted = wantedOf(id);
        if (_asked[id] == wanted) continue;
        _asked[id] = wanted;
        _last = id;
        return wanted;
    }
    return std::nullopt;
}

std::vector<LogCode> MaskKeeper::takeRefused(const std::optional<LogMask>& inForce) {
    std::vector<LogCode> codes;
    const LogMask& asked = *_asked[_last];
    for (std::uint32_t item = 0; item < asked.items(); ++item) {
        const LogCode code = _last << 12 | item;
        if (asked.test(code) && !(inForce && inForce->test(code))) tellOnce(code, codes);
    }
    return codes;
}

LogMask MaskKeeper::wantedOf(std::uint32_t equipment) const {
    LogMask mask(equipment, _ranges[equipment]);
    for (std::uint32_t item = 0; item < mask.items(); ++item) {
        const LogCode code = equipment << 12 | item;
        if (_wanted.test(code)) mask.set(code);
    }
    return mask;
}

void MaskKeeper::tellOnce(LogCode code, std::vector<LogCode>& codes) {
    if (_told.test(code)) return;
    _told.set(code);
    codes.push_back(code);
}

}  // namespace kelvo::wire
