// refused: no matching function for call to
#include "LogGenerator/LTE/LTECodes.h"
#include "LogGenerator/ShowFields.h"

using namespace kelvo;

constexpr auto kCell = record(0xB0C2, 22, {{20, u8, "Tx Antennas", decimal}});
