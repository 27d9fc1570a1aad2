#pragma once

#include <vector>

#include "telephony/wire/CandidateNode.h"

namespace kelvo::wire {

/// The serial nodes of this system that a modem may be behind (ttyUSB*, ttyACM* and ttyHS*), as udev knows them: the
/// likeliest first, those of one kind by their modem and their interface's number. Opens none of them.
std::vector<CandidateNode> findCandidates();

}  // namespace kelvo::wire
