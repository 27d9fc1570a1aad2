#include "LogGenerator/LTE/ReselectionCandidatesList.h"

#include "LogGenerator/RowWriter.h"
#include "platform/system/Environment.h"

namespace kelvo {

namespace {

constexpr std::size_t kStride = 4;  // intended: shorter than a candidate, so that the fields of neighbors overlap

// clang-format off
constexpr ValueTable kTechnology({
    { 0, "LTE"       },
    { 1, "UTRAN"     },
    { 2, "GERAN"     },
    { 3, "CDMA1XRTT" },
    { 4, "CDMAHRPD"  },
}, "??");

constexpr auto kCandidate = entry(12, {
    {  0, u16,             "Candidate Priority", decimal            },
    {  2, u16,             "Candidate RAT Type", label(kTechnology) },
});

constexpr auto kLte = entry(12, {
    {  4, u16,             "E ARFCN",            decimal            },
    {  6, u16.bits(7, 15), "Cell ID",            decimal            },
});

constexpr auto kUtran = entry(12, {
    {  4, u16,             "U ARFCN",            decimal            },
    {  6, u16,             "PSC",                decimal            },
});

constexpr auto kGeran = entry(12, {
    {  4, u16,             "ARFCN",              decimal            },
    {  6, u8,              "Band",               decimal            },
    {  7, u8,              "BSIC ID",            decimal            },
});

constexpr auto kCdma = entry(12, {
    {  4, u8,              "Band",               decimal            },
    {  8, u16,             "Channel",            decimal            },
    { 10, u16,             "Pilot",              decimal            },
});
// clang-format on

std::span<const Field> fieldsOfTechnology(std::int64_t type) {
    switch (type) {
        case 0: return kLte.fields;
        case 1: return kUtran.fields;
        case 2: return kGeran.fields;
        case 3:
        case 4: return kCdma.fields;
        default: return {};
    }
}

}  // namespace

void ReselectionCandidatesList::updateWithData(ByteView data, LogCode logCode) {
    logLine(Level::Warning, "Reselection Candidates List");
    if (logCode != 0xB186) return reportUnknown(logCode);
    if (data.size() < 21) return;
    const RecordView record(data);
    const auto count = static_cast<std::size_t>(record.read(19, u8));  // the low byte alone of a 16-bit count
    const RecordEntries candidates = RecordEntries(21, kStride, count).within(data.size());
    RowWriter rows(list());
    for (std::size_t i = 0; i < candidates.count(); ++i) {
        const std::size_t at = candidates.offsetOf(i);
        Dictionary::Rewrite row = rows.next();
        showFields(row, record, at, kCandidate.fields);
        showFields(row, record, at, fieldsOfTechnology(record.read(at + 2, u16)));
    }
}

}  // namespace kelvo
