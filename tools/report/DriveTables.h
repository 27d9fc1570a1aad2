#pragma once

#include <string>

#include "tools/report/Drive.h"

/// The tables of one recording, in HTML; empty where there is nothing to tell.
namespace kelvo::report {

std::string levelTable(const Drive& drive);
std::string servingTable(const Drive& drive);
std::string neighborTable(const Drive& drive);
/// How long each state lasted in all.
std::string stateTable(const Drive& drive);
std::string eventTable(const Drive& drive);
/// What the file held that Kelvo could not read.
std::string unreadPart(const Drive& drive);

}  // namespace kelvo::report
