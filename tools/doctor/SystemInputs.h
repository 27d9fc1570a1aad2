#pragma once

#include "tools/doctor/Doctor.h"

namespace kelvo {

/// What this system has: its nodes, processes, buses and users. Needs a QCoreApplication.
DoctorInputs systemInputs();

}  // namespace kelvo
