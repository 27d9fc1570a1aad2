#include "telephony/simulation/ExtendedRecords.h"

#include <cstdio>

#include "platform/values/Value.h"
#include "telephony/simulation/RecordWriter.h"

namespace kelvo::simulation {
namespace {

std::string hexadecimal(int value, int digits) {
    char text[12];
    std::snprintf(text, sizeof text, "%0*X", digits, static_cast<unsigned>(value));
    return text;
}

enum class UpdateStatus { Updated = 0, NotUpdated = 1 };  // 3GPP TS 31.102, 4.2.17 and 4.2.23

SimFiles simFiles(int locationAreaCode, int routingAreaCode, UpdateStatus updateStatus) {
    const std::string plmn = "00F110";  // 001 01, digits swapped and filled as in 3GPP TS 24.008, 10.5.1.3
    const std::string area = plmn + hexadecimal(locationAreaCode, 4);
    const std::string status = hexadecimal(static_cast<int>(updateStatus), 2);
    return {
        .iccid = "8900101000000123456",
        .msisdn = "+0015550123",
        .mbdn = "+0015550100",
        .hpplmn = "05",
        .loci = "3A9C41D7" + area + "FF" + status,  // TMSI, area, a byte without meaning
        .psloci = "C41B7E02A95D13" + area + hexadecimal(routingAreaCode, 2) + status,
        .acc = "0008",
        .ad = "00000102",  // normal operation; MNC of 2 digits
        .fplmn = "00F120FFFFFFFFFFFFFFFFFF",
        .ahplmn = plmn,
        .ratMode = "00",
        .pnn = "Test Network",
        .opl = plmn + "0000FFFE01",  // every area: the first name
        .oplmnAct = plmn + "C080",   // UTRAN, E-UTRAN and GSM
    };
}

}  // namespace

SimFiles testNetworkSim(int locationAreaCode, int routingAreaCode) {
    return simFiles(locationAreaCode, routingAreaCode, UpdateStatus::Updated);
}

SimFiles testNetworkSim() {
    return simFiles(0xfffe, 0xff, UpdateStatus::NotUpdated);  // both "deleted": 3GPP TS 23.003, 4.1 and 4.2
}

Bytes simFilesRecord(Time time, const SimFiles& files) {
    return propertyListRecord(time, 0xff0000, phone::simFilesPayload(files));
}

Bytes cellInformationRecord(Time time, std::span<const MonitoredCell> cells) {
    return propertyListRecord(time, 0xff0001, phone::cellInformationPayload(cells));
}

Bytes pdpContextsRecord(Time time, std::span<const PdpContext> contexts) {
    return propertyListRecord(time, 0xff0002, phone::pdpContextsPayload(contexts));
}

}  // namespace kelvo::simulation
