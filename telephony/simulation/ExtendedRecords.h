#pragma once

#include <optional>
#include <span>
#include <string>

#include "platform/values/Bytes.h"
#include "telephony/simulation/Time.h"

namespace kelvo::simulation {

/// The SIM's elementary files (3GPP TS 31.102), each as the text that the modem reports of it; a file that is empty is
/// not in the record.
struct SimFiles {
    std::string iccid = {};
    std::string msisdn = {};
    std::string mbdn = {};
    std::string hpplmn = {};
    std::string loci = {};
    std::string psloci = {};
    std::string acc = {};
    std::string ad = {};
    std::string fplmn = {};
    std::string ahplmn = {};
    std::string ratMode = {};
    std::string pnn = {};
    std::string opl = {};
    std::string oplmnAct = {};
};

/// A SIM of the test network MCC 001, MNC 01 (ITU-T E.212) that was last registered in this area: the files that name
/// an area follow it, the others never change.
SimFiles testNetworkSim(int locationAreaCode, int routingAreaCode);
/// The same SIM registered nowhere: its area is deleted and its update status "not updated".
SimFiles testNetworkSim();

/// Record 0xff0000.
Bytes simFilesRecord(Time time, const SimFiles& files);

/// One cell as the telephony service's cell monitor describes it. A value that is none is not in the record.
struct MonitoredCell {
    enum class Technology { GSM, UMTS, UTRAN2, LTE };
    static constexpr int kNoValue = 32767;        ///< under RSSI, RSCP and Ec/N0: known, but not measured now
    static constexpr std::size_t kNeighbors = 2;  ///< beside the serving cell, where the strongest are listed

    Technology technology = Technology::GSM;
    bool isServing = false;
    std::optional<int> mcc = {};
    std::optional<int> mnc = {};
    std::optional<int> lac = {};
    std::optional<int> tac = {};
    std::optional<int> cellId = {};
    std::optional<int> pid = {};  ///< the physical cell identity of an LTE cell
    std::optional<int> arfcn = {};
    std::optional<int> uarfcn = {};  ///< of an LTE cell its EARFCN
    std::optional<int> scn = {};     ///< scrambling code
    std::optional<int> bandInfo = {};
    std::optional<int> rssi = {};  ///< of a GSM cell in units of 2 dB: -50 is -100 dBm
    std::optional<int> rscp = {};  ///< dBm
    std::optional<int> ecn0 = {};  ///< dB
};

/// Record 0xff0001: the cells in this order.
Bytes cellInformationRecord(Time time, std::span<const MonitoredCell> cells);

/// One packet data protocol context; all texts as shown, an empty one is not in the record.
struct PdpContext {
    int id = 5;              ///< NSAPI or EPS bearer identity
    std::string apn = {};    ///< access point name
    std::string type = {};   ///< "IPv4", "IPv6" or "IPv4v6"
    std::string state = {};  ///< "Active", "Inactive"
    std::string address = {};
    std::string qos = {};  ///< traffic class or QoS class identifier
    bool operator==(const PdpContext&) const = default;
};

/// Record 0xff0002: the contexts in this order.
Bytes pdpContextsRecord(Time time, std::span<const PdpContext> contexts);

}  // namespace kelvo::simulation
