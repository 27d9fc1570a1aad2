#pragma once

#include <span>

#include "platform/values/Bytes.h"
#include "telephony/phone/PhonePayloads.h"
#include "telephony/simulation/Time.h"

namespace kelvo::simulation {

using phone::MonitoredCell;
using phone::PdpContext;
using phone::SimFiles;

/// So many neighbors are monitored beside the serving cell, where the strongest are listed.
inline constexpr std::size_t kMonitoredNeighbors = 2;

/// A SIM of the test network MCC 001, MNC 01 (ITU-T E.212) that was last registered in this area: the files that name
/// an area follow it, the others never change.
SimFiles testNetworkSim(int locationAreaCode, int routingAreaCode);
/// The same SIM registered nowhere: its area is deleted and its update status "not updated".
SimFiles testNetworkSim();

/// Record 0xff0000.
Bytes simFilesRecord(Time time, const SimFiles& files);

/// Record 0xff0001: the cells in this order.
Bytes cellInformationRecord(Time time, std::span<const MonitoredCell> cells);

/// Record 0xff0002: the contexts in this order.
Bytes pdpContextsRecord(Time time, std::span<const PdpContext> contexts);

}  // namespace kelvo::simulation
