#pragma once

#include <CLI/App.hpp>

namespace kelvo {

/// "kelvoctl doctor": which port a modem is behind, what is in the way, and what to do next. Changes nothing.
void addDoctorCommand(CLI::App& app);

}  // namespace kelvo
