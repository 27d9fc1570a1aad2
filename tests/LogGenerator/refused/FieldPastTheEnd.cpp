// refused: throw "a field lies past the end"
#include "LogGenerator/LTE/LTECodes.h"
#include "LogGenerator/ShowFields.h"

using namespace kelvo;

constexpr auto kCell = record(code::kLTEServingCell, 22, {{20, u8, "Tx Antennas", decimal}, {21, u16, "PCI", decimal}});
