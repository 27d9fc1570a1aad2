#include "telephony/adaptation/IdleCells.h"

#include <algorithm>

namespace kelvo::adaptation {

IdleCells::Cell* IdleCells::find(std::uint32_t earfcn, std::uint16_t pci) {
    const auto cell = std::ranges::find_if(
        _cells, [&](const Cell& cell) { return cell.heard != 0 && cell.earfcn == earfcn && cell.pci == pci; });
    return cell == _cells.end() ? nullptr : &*cell;
}

void IdleCells::remember(std::uint32_t earfcn, std::uint16_t pci, const std::uint8_t* payload) {
    Cell* cell = find(earfcn, pci);
    if (cell == nullptr) cell = &*std::ranges::min_element(_cells, {}, &Cell::heard);
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
