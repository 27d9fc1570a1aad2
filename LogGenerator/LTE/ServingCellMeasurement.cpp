#include "LogGenerator/LTE/ServingCellMeasurement.h"

#include "platform/system/Environment.h"

namespace kelvo {

namespace {

// clang-format off
constexpr auto kMeasurement = record(code::kLTEServingCellIdle, 33, {
    { 13, u8,               "Version",                                decimal                                      },
    { 17, u16,              "E-ARFCN",                                decimal                                      },
    { 19, u16.bits( 0,  8), "Physical Cell ID",                       decimal                                      },
    { 19, u16.bits( 9, 12), "Serving Layer Priority",                 decimal                                      },
    { 21, u32.bits( 0,  8), "Measured RSRP",                          linear(0.25, -140.0, "%4.2f", dBm)           },
    { 21, u32.bits( 9, 17), "Average RSRP",                           linear(0.25, -140.0, "%4.2f", dBm)           },
    { 21, u32.bits(18, 24), "Measured RSRQ",                          linear(0.25,  -30.0, "%4.2f", dB)            },
    { 21, u32.bits(25, 31), "Average RSRQ",                           linear(0.25,  -30.0, "%4.2f", dB)            },
    { 25, u32.bits( 0,  8), "Measured RSSI",                          linear(0.5,  -140.0, "%4.2f", dBm)           },
    { 25, u32.bits( 9, 14), "Qrxlevmin",                              whole(2, -140, dBm)                          },
    { 25, u32.bits(15, 21), "P_Max",                                  whole(1, -30, dBm).unless(64, "Not Present") },
    { 25, u32.bits(22, 27), "Max UE Tx Power",                        whole(1, -30, dBm).unless(64, "Not Present") },  // 6 bits never reach 64; kept so
    { 29, u32.bits( 0,  6), "Srxlev",                                 whole(1, -30, dBm)                           },
    { 29, u32.bits( 7, 12), "Num of Consecutive DRX Cycles of S < 0", decimal                                      },
    { 29, u32.bits(13, 18), "S Intra Search",                         whole(2, 0, dB).unless(32, "Not Present")    },
    { 29, u32.bits(19, 24), "S Non Intra Search",                     whole(2, 0, dBm).unless(32, "Not Present")   },  // dBm is intended
    { 29, u32.bit(25),      "Measurement Rules Updated",              flag("True", "False")                        },
    { 29, u32.bits(26, 29), "Measurement Rules",                      decimal                                      },
});
// clang-format on

}  // namespace

void ServingCellMeasurement::updateWithData(ByteView data, LogCode logCode) {
    logLine(Level::Warning, "Serving Cell Measurements");
    showOneOf(data, logCode, kMeasurement);
}

}  // namespace kelvo
