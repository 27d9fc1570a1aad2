#include "LogGenerator/GSMUMTS/HSDPAInformation.h"

#include "platform/system/Environment.h"

namespace kelvo {

namespace {

// clang-format off
constexpr ValueTable kCarriers({
    { 0, "Single Carrier" },
    { 1, "MIMO"           },
    { 2, "Dual Carrier"   },
    { 3, "Reserved"       },
}, "Unknown");

constexpr auto kDownlink = record(code::kHSDPA, 18, {
    { 13, u8,               "Version",      asUnsigned       },
    { 14, u16.bits( 0,  9), "Sub Frames",   asUnsigned       },
    { 14, u16.bits(10, 11), "Carrier Info", label(kCarriers) },
});

constexpr auto kProcess = entry(9, {
    { 0,  u8,               "Process ID",   asUnsigned       },
    { 1,  u32,              "No Rx Bits",   asUnsigned       },
    { 5,  u16,              "New Tx",       asUnsigned       },
    { 7,  u16,              "Block Errors", asUnsigned       },
});
// clang-format on

}  // namespace

void HSDPAInformation::updateWithData(ByteView data, LogCode logCode) {
    logLine(Level::Warning, "HSDPA Info");
    if (logCode != code::kHSDPA || !show(data, kDownlink)) return;
    const RecordView record(data);
    const auto primary = record.count(16, u8);
    const auto secondary = record.count(17, u8);
    showProcesses("Primary HARQ Process", data, 18, primary);
    showProcesses("Secondary HARQ Process", data, 18 + 162 * primary, secondary);  // intended: a gap lies before them
}

void HSDPAInformation::showProcesses(Key key, ByteView data, std::size_t start, std::size_t count) {
    if (count == 0 || !values()) return;
    const ArrayRef processes = Array::make();
    showRows(processes, data, start, count, kProcess);
    values()->set(key, processes);
}

}  // namespace kelvo
