#include "LogGenerator/CDMA/C2KPilotList.h"

#include <fmt/format.h>

#include "LogGenerator/ShowFields.h"

namespace kelvo {

C2KPilotList::C2KPilotList(std::size_t pilots) { _rows->reserve(1 + pilots); }

void C2KPilotList::add(std::size_t position, std::int64_t pn, double level, const ShownReal& shown) {
    showReal(_rows->slot(fmt::format("{};{}", position, pn)), level, shown);
}

Value C2KPilotList::rowsOrNone() const {
    if (_rows->size() == 1) return "(none)";  // nothing but the mark of the key order
    return _rows;
}

}  // namespace kelvo
