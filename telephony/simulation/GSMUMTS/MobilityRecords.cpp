#include "telephony/simulation/GSMUMTS/MobilityRecords.h"

#include "telephony/simulation/RecordWriter.h"

namespace kelvo::simulation::gsm {
namespace {

constexpr int kUpdated = 0;
constexpr int kNotUpdated = 1;
constexpr int kAutomatic = 0;

}  // namespace

// clang-format off

Bytes packetStateRecord(Time time, const Mobility& mobility) {
    return RecordWriter(time, 0x7130, 16)
        .i8(13, static_cast<int>(mobility.gmm))
        .i8(14, static_cast<int>(mobility.gmmSub))
        .i8(15, mobility.isRoutingUpdated ? kUpdated : kNotUpdated)
        .finish();
}

Bytes circuitStateRecord(Time time, const Mobility& mobility) {
    return RecordWriter(time, 0x7131, 16)
        .i8(13, static_cast<int>(mobility.mm))
        .i8(14, static_cast<int>(mobility.mmSub))
        .i8(15, mobility.isLocationUpdated ? kUpdated : kNotUpdated)
        .finish();
}

Bytes registrationRecord(Time time, const Mobility& mobility) {
    return RecordWriter(time, 0x7132, 16)
        .i8(13, static_cast<int>(mobility.registration))
        .i8(14, kAutomatic)
        .finish();
}

Bytes servingNetworkRecord(Time time, const ServingNetwork& network) {
    constexpr int kFiller = 0xf;  // in the place of a third digit of the network code
    const int mcc[] = {kMcc / 100, kMcc / 10 % 10, kMcc % 10};
    const int mnc[] = {kMnc / 10, kMnc % 10, kFiller};
    return RecordWriter(time, 0x7135, 32)
        .i8(13, network.operationMode)
        .i8(14, static_cast<int>(network.service))
        .i8(15, mcc[1] << 4 | mcc[0])
        .i8(16, mnc[2] << 4 | mcc[2])
        .i8(17, mnc[1] << 4 | mnc[0])
        .i8(18, network.area.lac >> 8)  // big-endian, as on the air
        .i8(19, network.area.lac & 0xff)
        .i8(20, network.area.rac)
        .finish();
}

Bytes equivalentPlmnsRecord(Time time, std::span<const Plmn> plmns) {
    RecordWriter record(time, 0x7150, 17);
    record.u8(16, plmns.size());
    std::size_t at = 17;
    for (const Plmn& plmn : plmns) {
        record
            .i8(at + 0, plmn.mcc / 100)
            .i8(at + 1, plmn.mnc / 100)
            .i8(at + 2, plmn.mcc / 10 % 10)
            .i8(at + 3, plmn.mnc / 10 % 10)
            .i8(at + 4, plmn.mcc % 10)
            .i8(at + 5, plmn.mnc % 10);
        at += 3;
    }
    return record.finish();
}

// clang-format on

}  // namespace kelvo::simulation::gsm
