#pragma once

#include <CLI/App.hpp>
#include <memory>

namespace kelvo {

/// The command line of kelvoctl with every command. Parsing it runs the command; `main` parses it, and the manual and
/// the completions are made of it.
std::unique_ptr<CLI::App> makeKelvoctl();

}  // namespace kelvo
