#pragma once

#include "platform/values/Key.h"

/// Names that the telephony service and its clients share. Each constant's value is its own name.
namespace kelvo {

// The technology families a modem can speak, as the service answers "GetTechnology".
inline constexpr std::string_view kPLLogChannelTechnology_IFX = "kPLLogChannelTechnology_IFX";
inline constexpr std::string_view kPLLogChannelTechnology_Oskra_GSM = "kPLLogChannelTechnology_Oskra_GSM";
inline constexpr std::string_view kPLLogChannelTechnology_Oskra_CDMA = "kPLLogChannelTechnology_Oskra_CDMA";
inline constexpr std::string_view kPLLogChannelTechnology_Oskra_LTE = "kPLLogChannelTechnology_Oskra_LTE";
inline constexpr std::string_view kPLLogChannelTechnology_Oskra_UTRAN2 = "kPLLogChannelTechnology_Oskra_UTRAN2";

// Keys of one cell's dictionary in a cell-information array (the 0xff0001 record).
inline constexpr std::string_view kPLCellMonitorCellRadioAccessTechnology = "kPLCellMonitorCellRadioAccessTechnology";
inline constexpr std::string_view kPLCellMonitorCellType = "kPLCellMonitorCellType";
inline constexpr std::string_view kPLCellMonitorMCC = "kPLCellMonitorMCC";
inline constexpr std::string_view kPLCellMonitorMNC = "kPLCellMonitorMNC";
inline constexpr std::string_view kPLCellMonitorLAC = "kPLCellMonitorLAC";
inline constexpr std::string_view kPLCellMonitorTAC = "kPLCellMonitorTAC";
inline constexpr std::string_view kPLCellMonitorCellId = "kPLCellMonitorCellId";
inline constexpr std::string_view kPLCellMonitorPID = "kPLCellMonitorPID";
inline constexpr std::string_view kPLCellMonitorARFCN = "kPLCellMonitorARFCN";
inline constexpr std::string_view kPLCellMonitorUARFCN = "kPLCellMonitorUARFCN";
inline constexpr std::string_view kPLCellMonitorSCN = "kPLCellMonitorSCN";
inline constexpr std::string_view kPLCellMonitorBandInfo = "kPLCellMonitorBandInfo";
inline constexpr std::string_view kPLCellMonitorRSSI = "kPLCellMonitorRSSI";
inline constexpr std::string_view kPLCellMonitorRSCP = "kPLCellMonitorRSCP";
inline constexpr std::string_view kPLCellMonitorECN0 = "kPLCellMonitorECN0";

// Values under kPLCellMonitorCellRadioAccessTechnology and kPLCellMonitorCellType.
inline constexpr std::string_view kPLCellMonitorRadioAccessTechnologyGSM = "kPLCellMonitorRadioAccessTechnologyGSM";
inline constexpr std::string_view kPLCellMonitorRadioAccessTechnologyUMTS = "kPLCellMonitorRadioAccessTechnologyUMTS";
inline constexpr std::string_view kPLCellMonitorRadioAccessTechnologyUTRAN2 =
    "kPLCellMonitorRadioAccessTechnologyUTRAN2";
inline constexpr std::string_view kPLCellMonitorRadioAccessTechnologyLTE = "kPLCellMonitorRadioAccessTechnologyLTE";
inline constexpr std::string_view kPLCellMonitorCellTypeServing = "kPLCellMonitorCellTypeServing";
inline constexpr std::string_view kPLCellMonitorCellTypeNeighbor = "kPLCellMonitorCellTypeNeighbor";

}  // namespace kelvo
