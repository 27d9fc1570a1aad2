#pragma once

#include <CLI/App.hpp>

namespace kelvo {

/// "report": what recordings have to tell, as one page for a browser or for paper.
void addReportCommand(CLI::App& app);

}  // namespace kelvo
