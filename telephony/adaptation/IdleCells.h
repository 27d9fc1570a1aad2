#pragma once

#include <array>
#include <cstdint>

#include "platform/values/Bytes.h"

namespace kelvo::adaptation {

/// The last payload of a fixed 0xB17F record for each of the 64 cells heard last.
class IdleCells {
public:
    using Payload = std::array<std::uint8_t, 20>;

    /// A real record of the cell has come. `payload` holds at least 20 bytes.
    void remember(std::uint32_t earfcn, std::uint16_t pci, const std::uint8_t* payload);
    /// The cell was heard again: its last record, none when there is none. Good until the next `remember`.
    const Payload* recall(std::uint32_t earfcn, std::uint16_t pci);

private:
    static constexpr std::size_t kCells = 64;
    struct Cell {
        std::uint64_t heard = 0;
        std::uint32_t earfcn = 0;
        std::uint16_t pci = 0;
        Payload payload{};
    };

    Cell* find(std::uint32_t earfcn, std::uint16_t pci);

    std::array<Cell, kCells> _cells{};
    std::size_t _used = 0;  // places, from the first on
    std::uint64_t _heard = 0;
};

}  // namespace kelvo::adaptation
