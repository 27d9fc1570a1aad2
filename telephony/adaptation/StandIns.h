#pragma once

#include <span>

#include "LogGenerator/LogCode.h"

namespace kelvo::adaptation {

/// The codes of fixed layouts that newer modems send others for.
std::span<const LogCode> codesWithStandIns();

/// The codes that newer modems send instead of `code`, a code of a fixed layout: who asks for it asks for these too.
std::span<const LogCode> standInsFor(LogCode code);

/// The code without its SIM: phones with two SIMs send the GSM codes and 0x51FC plus 0xA00, with the SIM's byte in
/// front of the payload. The code itself when it is none of these.
LogCode withoutSim(LogCode code);

}  // namespace kelvo::adaptation
