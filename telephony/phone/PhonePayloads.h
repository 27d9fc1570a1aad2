#pragma once

#include <optional>
#include <span>
#include <string>

namespace kelvo {
class Value;
}

/// What the records of the phone's own services carry (log type 255): property lists of SIM files, cells and data
/// contexts.
namespace kelvo::phone {

/// The SIM's elementary files (3GPP TS 31.102), each as the text that is reported of it; a file that is empty is not in
/// the record.
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

    bool operator==(const SimFiles&) const = default;
};

/// One cell as the telephony service's cell monitor describes it. A value that is none is not in the record.
struct MonitoredCell {
    enum class Technology { GSM, UMTS, UTRAN2, LTE };
    static constexpr int kNoValue = 32767;  ///< under RSSI, RSCP and Ec/N0: known, but not measured now

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

    bool operator==(const MonitoredCell&) const = default;
};

/// One packet data protocol context; all texts as shown, an empty one is not in the record.
struct PdpContext {
    std::optional<int> id = 5;  ///< NSAPI or EPS bearer identity, or the profile that it was made of; none: not known
    std::string apn = {};       ///< access point name
    std::string type = {};      ///< "IPv4", "IPv6" or "IPv4v6"
    std::string state = {};     ///< "Active", "Inactive"
    std::string address = {};
    std::string qos = {};  ///< traffic class, QoS class identifier, or the negotiated bit rates

    bool operator==(const PdpContext&) const = default;
};

Value simFilesPayload(const SimFiles& files);                        ///< of record 0xff0000
Value cellInformationPayload(std::span<const MonitoredCell> cells);  ///< of record 0xff0001: the cells in this order
Value pdpContextsPayload(std::span<const PdpContext> contexts);      ///< of record 0xff0002, likewise

}  // namespace kelvo::phone
