#pragma once

#include <array>
#include <cstdint>
#include <optional>

#include "platform/values/Bytes.h"
#include "telephony/adaptation/CarryOut.h"
#include "telephony/adaptation/IdleCells.h"
#include "telephony/adaptation/Refusal.h"

namespace kelvo::adaptation {

/// What became of a record.
struct Adapted {
    enum class Outcome : std::uint8_t { Passed, Turned, Refused };
    enum class Derivation : std::uint8_t {
        None,
        Completed,  ///< a 0xB17F made of a 0xB193 and what the cell's last real 0xB17F said
        Neutral,    ///< likewise, of a cell without one: criteria and limits hold the standard's neutral values
    };

    Outcome outcome = Outcome::Refused;
    ByteView packet;    ///< passed: the one that was given; turned: the adapter's, until its next record
    RecordKind kind{};  ///< what came in
    Refusal refusal = Refusal::NotKnown;  ///< of a refused one
    Derivation derivation = Derivation::None;
    std::optional<std::uint32_t> channel;  ///< an EARFCN above 65,535, which the packet says as 65535
    int leftOut = 0;                       ///< list entries that the fixed layout has no room for
};

/// Turns the records of newer modems into the fixed layouts that Kelvo decodes, and refuses what it cannot turn: a
/// layout is recognised by code, version and exact length. A record in a fixed layout passes byte for byte, so adapting
/// twice changes nothing. Records of the phone's own services (type 255) pass.
///
/// No allocation. It remembers the last real 0xB17F of the 64 LTE cells heard last, which complete records that say
/// less.
class RecordAdapter {
public:
    /// Takes a packet from its log type byte on, without a prefix, as long as its length says. Borrowed for the call.
    Adapted adapt(ByteView packet);

    /// The payload of the last real 0xB17F of a cell; null when there is none. Good until the next record.
    const IdleCells::Payload* lastIdle(std::uint32_t earfcn, std::uint16_t pci) {
        return _idleCells.recall(earfcn, pci);
    }

private:
    std::optional<Refusal> adaptMasterInformation(ByteView payload);
    std::optional<Refusal> adaptServingCell(ByteView payload);
    std::optional<Refusal> adaptConnected(ByteView payload);
    std::optional<Refusal> adaptIdle(ByteView payload);
    std::optional<Refusal> adaptNeighbors(ByteView payload);
    std::optional<Refusal> adaptAnyMode(ByteView payload);
    std::optional<Refusal> adaptRanking(ByteView payload);
    std::optional<Refusal> adaptCellIdentity(ByteView payload);
    std::optional<Refusal> adaptCells(ByteView payload);
    std::optional<Refusal> adaptNetworks(ByteView payload);

    std::optional<Refusal> deriveIdle(ByteView part, const Turning& layout);
    std::optional<Refusal> turn(const Turning& layout, ByteView payload, std::size_t fixedSize);
    void passes() { _result.outcome = Adapted::Outcome::Passed; }
    std::optional<Refusal> turned(std::size_t payloadSize, LogCode code);
    std::uint8_t* payloadMade() { return _made.data() + kHeader; }
    void tellChannel(std::int64_t earfcn);

    static constexpr std::size_t kHeader = 13;
    /// The greatest: 0xB179 with 255 measured and 255 detected cells.
    static constexpr std::size_t kGreatestPayload = 16 + 255 * 6 + 255 * 2;
    std::array<std::uint8_t, kHeader + kGreatestPayload> _made{};
    Adapted _result;  // of the record in hand
    IdleCells _idleCells;
};

}  // namespace kelvo::adaptation
