#include "LogGenerator/GSMUMTS/ProcessCO.h"

#include "LogGenerator/GSMUMTS/MMStates.h"

namespace kelvo {

namespace {

// clang-format off
constexpr auto kState = record(16, {  // 0x7131
    { 13, u8, "MM State", label(kMMStates) },
});
// clang-format on

}  // namespace

void ProcessCO::showState(ByteView data) const { show(data, kState); }

}  // namespace kelvo
