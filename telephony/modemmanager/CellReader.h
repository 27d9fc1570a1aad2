#pragma once

#include <optional>
#include <vector>

#include "telephony/modemmanager/AccessTechnology.h"
#include "telephony/modemmanager/BusValues.h"
#include "telephony/phone/PhonePayloads.h"
#include "telephony/phone/PhoneState.h"

/// ModemManager's words for cells and levels in those of the cell array.
namespace kelvo::modemmanager {

/// A cell of GetCellInfo; none where the cell array has no such cells (CDMA, 5G).
std::optional<phone::MonitoredCell> cellOf(const QVariantMap& told);

/// The levels that an LTE cell of GetCellInfo tells of itself.
phone::LteLevels levelsOfCell(const QVariantMap& told);

/// Those of the interface Signal, and of the cell what that does not tell.
phone::LteLevels levelsOf(const QVariantMap& signal, const phone::LteLevels& ofCell);

/// Puts the levels of the interface Signal (its property for this technology) into the cell that serves.
void setLevels(phone::MonitoredCell& serving, const QVariantMap& signal);

/// The cell that serves by what the registration tells of it: the network's code ("00101") and GetLocation's text
/// ("001,01,84CD,2BAF,6FFE"); either may be empty.
phone::MonitoredCell registeredCell(phone::MonitoredCell::Technology technology, const std::string& network,
                                    const std::string& location);

}  // namespace kelvo::modemmanager
