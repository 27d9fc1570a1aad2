#include "telephony/adaptation/IdleCells.h"

#include <algorithm>
#include <span>

namespace kelvo::adaptation {

IdleCells::Cell* IdleCells::find(std::uint32_t earfcn, std::uint16_t pci) {
    const std::span<Cell> used(_cells.data(), _used);
    const auto cell = std::ranges::find_if(used, [&](const Cell& c) { return c.earfcn == earfcn && c.pci == pci; });
    return cell == used.end() ? nullptr : &*cell;
}

void IdleCells::remember(std::uint32_t earfcn, std::uint16_t pci, const std::uint8_t* payload) {
    Cell* cell = find(earfcn, pci);
    if (cell == nullptr) {
        cell = _used < kCells ? &_cells[_used++] : &*std::ranges::min_element(_cells, {}, &Cell::heard);
    }
    cell->heard = ++_heard;
    cell->earfcn = earfcn;
    cell->pci = pci;
    std::copy_n(payload, cell->payload.size(), cell->payload.begin());
}

const IdleCells::Payload* IdleCells::recall(std::uint32_t earfcn, std::uint16_t pci) {
    Cell* cell = find(earfcn, pci);
    if (cell == nullptr) return nullptr;
    cell->heard = ++_heard;
    return &cell->payload;
}

}  // namespace kelvo::adaptation
