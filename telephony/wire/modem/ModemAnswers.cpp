#include "telephony/wire/modem/ModemAnswers.h"

#include <algorithm>

namespace kelvo::modem {
namespace {

using wire::Command;
using wire::Operation;
using wire::Refusal;

// clang-format off
// What a phone has, of each equipment: 1 is 1x, EV-DO and general, 4 UMTS, 5 GSM (of two SIMs from 0xA00 on), 7 mobility
// management, 11 LTE, 13 TD-SCDMA.
constexpr wire::Ranges kRanges{
    0, 0xA02, 0, 0, 0x910, 0xE20, 0, 0x4FF, 0, 0, 0x38A, 0x201, 0, 0x1FF, 0, 0};
// Each ends before the last record of its equipment that Kelvo shows: 0x134f, 0x4221, 0x51f6 to 0x51ff, 0x7150, 0xb180
// and 0xb186, 0xd0e2.
constexpr wire::Ranges kSmallerRanges{
    0, 0x300, 0, 0, 0x200, 0x1F6, 0, 0x140, 0, 0, 0x38A, 0x180, 0, 0x0E2, 0, 0};

struct Refusing {
    Fault fault;
    Refusal refusal;
    bool rangesToo;
};
constexpr Refusing kRefusing[] = {
    {Fault::BadCommand,   Refusal::BadCommand,   true },
    {Fault::BadParameter, Refusal::BadParameter, false},
    {Fault::BadLength,    Refusal::BadLength,    false},
    {Fault::BadMode,      Refusal::BadMode,      true },
    {Fault::Locked,       Refusal::Locked,       true },
    {Fault::Security,     Refusal::Security,     true },
    {Fault::Transaction,  Refusal::Transaction,  true },
};
// clang-format on

constexpr std::uint32_t kNoSuchEquipment = 1;  // a status

Bytes withByteBefore(std::uint8_t byte, ByteView rest) {
    Bytes bytes(1 + rest.size(), byte);
    std::ranges::copy(rest, bytes.begin() + 1);
    return bytes;
}

Bytes refuse(Refusal refusal, ByteView request) { return withByteBefore(static_cast<std::uint8_t>(refusal), request); }

Bytes good(Operation operation, ByteView data = {}) { return wire::configurationAnswer(operation, 0, data); }

// The mask without its last record.
wire::LogMask shortened(const wire::LogMask& mask) {
    std::uint32_t items = mask.items();
    while (items > 0 && !mask.test(static_cast<std::uint16_t>(mask.equipment() << 12 | (items - 1)))) --items;
    return items == 0 ? mask : wire::LogMask(mask.equipment(), items - 1, mask.bits());
}

}  // namespace

ModemAnswers::ModemAnswers(Faults faults)
    : _faults(faults), _masks(faults.has(Fault::SmallerRanges) ? kSmallerRanges : kRanges) {
    restart();
}

void ModemAnswers::restart() {
    _masks.clear();
    _events = _texts = _faults.has(Fault::EarlierSession);
    if (_faults.has(Fault::EarlierSession)) _masks.setAll();
}

Bytes ModemAnswers::version() {
    static constexpr std::string_view kTexts =
        "Jan 05 2012"
        "12:00:00"
        "Jan 06 2012"
        "12:00:00"
        "PLAYED  ";
    Bytes answer = withByteBefore(static_cast<std::uint8_t>(Command::Version), bytesOf(kTexts));
    answer.resize(answer.size() + 8);  // station class, revisions, model, slot cycle
    return answer;
}

Bytes ModemAnswers::buildId() {
    static constexpr std::string_view kText = "KELVO-MODEM-1";
    Bytes answer(wire::kBuildIdTextAt + kText.size() + 1);  // a zero at its end
    answer[0] = static_cast<std::uint8_t>(Command::BuildId);
    std::ranges::copy(kText, answer.begin() + wire::kBuildIdTextAt);
    return answer;
}

Bytes ModemAnswers::answer(ByteView request) {
    switch (static_cast<Command>(request[0])) {
        case Command::Version: return request.size() == 1 ? version() : refuse(Refusal::BadLength, request);
        case Command::BuildId: return request.size() == 1 ? buildId() : refuse(Refusal::BadLength, request);
        case Command::Event:
            if (request.size() != wire::kEventsOff.size()) return refuse(Refusal::BadLength, request);
            _events = request[1] != 0;
            return {request[0], 0, 0};  // an event report without events
        case Command::TextConfiguration:
            if (request.size() != wire::kTextsOff.size()) return refuse(Refusal::BadLength, request);
            if (request[1] != wire::kTextsOff[1]) return refuse(Refusal::BadParameter, request);
            _texts = std::ranges::any_of(request.subspan(4), [](std::uint8_t byte) { return byte != 0; });
            return Bytes(request.begin(), request.end());
        case Command::RecordConfiguration: return configure(request);
        default: return refuse(Refusal::BadCommand, request);
    }
}

Bytes ModemAnswers::configure(ByteView request) {
    const auto parsed = wire::parseConfigurationRequest(request);
    if (!parsed) return refuse(Refusal::BadLength, request);
    if (const auto refusal = refusalOf(parsed->operation)) return refuse(*refusal, request);
    switch (parsed->operation) {
        case Operation::AllOff: _masks.clear(); return good(Operation::AllOff);
        case Operation::Ranges: return good(Operation::Ranges, wire::rangesData(_masks.ranges()));
        case Operation::SetMask: return setMask(request, parsed->data);
        case Operation::GetMask: {
            const auto equipment = wire::equipmentOf(parsed->data);
            if (!equipment) return refuse(Refusal::BadLength, request);
            if (*equipment >= wire::kEquipmentIds) return refuse(Refusal::BadParameter, request);
            return good(Operation::GetMask, wire::maskData(_masks.get(*equipment)));
        }
    }
    return refuse(Refusal::BadParameter, request);
}

Bytes ModemAnswers::setMask(ByteView request, ByteView data) {
    const auto mask = wire::parseMask(data);
    if (!mask) return refuse(Refusal::BadLength, request);
    const std::uint32_t equipment = mask->equipment();
    if (equipment >= wire::kEquipmentIds) return refuse(Refusal::BadParameter, request);
    _masks.set(_faults.has(Fault::SmallerMasks) ? shortened(*mask) : *mask);
    return wire::configurationAnswer(Operation::SetMask, _masks.ranges()[equipment] == 0 ? kNoSuchEquipment : 0,
                                     wire::maskData(_masks.get(equipment)));
}

std::optional<Refusal> ModemAnswers::refusalOf(Operation operation) const {
    for (const Refusing& refusing : kRefusing) {
        const bool meant = operation == Operation::SetMask || (refusing.rangesToo && operation == Operation::Ranges);
        if (meant && _faults.has(refusing.fault)) return refusing.refusal;
    }
    return std::nullopt;
}

}  // namespace kelvo::modem
