#include "telephony/adaptation/RecordAdapter.h"

#include <algorithm>

#include "LogGenerator/CodeNames.h"
#include "LogGenerator/Framing.h"
#include "telephony/adaptation/Minimum.h"
#include "telephony/adaptation/StandIns.h"

namespace kelvo::adaptation {

Adapted RecordAdapter::adapt(ByteView packet) {
    _result = Adapted{};
    _result.packet = packet;
    _result.kind.bytes = packet.size() > kHeader ? packet.size() - kHeader : 0;
    if (packet.size() < kHeader) {
        _result.refusal = Refusal::TooShort;
        return _result;
    }
    const LogCode sent = logCode(packet.data());
    _result.kind.code = sent;
    if ((sent & kExtendedLogCodes) == kExtendedLogCodes) {
        passes();
        return _result;
    }

    std::copy_n(packet.begin(), kHeader, _made.begin());
    ByteView payload = packet.subspan(kHeader);
    const LogCode code = withoutSim(sent);
    if (code != sent) {
        if (payload.empty()) {
            _result.refusal = Refusal::TooShort;
            return _result;
        }
        payload = payload.subspan(1);
    }

    std::optional<Refusal> refusal;
    switch (code) {
        case code::kLTEMasterInformationBlock: refusal = adaptMasterInformation(payload); break;
        case code::kLTEServingCell: refusal = adaptServingCell(payload); break;
        case code::kLTEIntraFrequency: refusal = adaptConnected(payload); break;
        case code::kLTEServingCellIdle: refusal = adaptIdle(payload); break;
        case code::kLTENeighborCellsIdle: refusal = adaptNeighbors(payload); break;
        case code::kLTEServingCellEveryMode: refusal = adaptAnyMode(payload); break;
        case code::kNeighborRanking: refusal = adaptRanking(payload); break;
        case code::kUMTSServingCell: refusal = adaptCellIdentity(payload); break;
        case code::kGPRSReselection: refusal = adaptCells(payload); break;
        case code::kEquivalentPLMNs: refusal = adaptNetworks(payload); break;
        default:
            if (code == sent) {
                refusal = lengthRefusal(code, packet);
                if (!refusal) passes();
            } else if (payload.size() > kGreatestPayload) {
                refusal = Refusal::NotKnown;
            } else {
                std::ranges::copy(payload, payloadMade());
                refusal = turned(payload.size(), code);
                if (!refusal) refusal = lengthRefusal(code, _result.packet);
            }
    }
    if (refusal) {
        _result.outcome = Adapted::Outcome::Refused;
        _result.packet = packet;
        _result.refusal = *refusal;
    }
    return _result;
}

/// The record made is whole: its header gets its length and code.
std::optional<Refusal> RecordAdapter::turned(std::size_t payloadSize, LogCode code) {
    const std::size_t size = kHeader + payloadSize;
    writeBits(_made.data() + 1, u16, static_cast<std::uint32_t>(size - 1));
    writeBits(_made.data() + 3, u16, code);
    _result.outcome = Adapted::Outcome::Turned;
    _result.packet = ByteView(_made.data(), size);
    return std::nullopt;
}

/// A record without lists.
std::optional<Refusal> RecordAdapter::turn(const Turning& layout, ByteView payload, std::size_t fixedSize) {
    std::fill_n(payloadMade(), fixedSize, std::uint8_t{0});
    if (!layout.carryOut(payload, payloadMade())) return Refusal::DoesNotFit;
    const RecordView record(payload);
    for (const Move& move : layout.moves) {
        if (move.turn == Turn::Channel) tellChannel(record.read(move.from, move.fromRaw));
    }
    return turned(fixedSize, _result.kind.code);
}

void RecordAdapter::tellChannel(std::int64_t earfcn) {
    if (earfcn > 65535 && !_result.channel) _result.channel = static_cast<std::uint32_t>(earfcn);
}

}  // namespace kelvo::adaptation
