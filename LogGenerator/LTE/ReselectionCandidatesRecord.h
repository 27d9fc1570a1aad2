#pragma once

#include <span>

#include "LogGenerator/FieldTable.h"
#include "LogGenerator/LTE/LTECodes.h"

namespace kelvo {

/// 0xB186: the serving cell and the cells, in LTE or another technology, that the phone may reselect to.
struct ReselectionCandidatesRecord {
    // clang-format off
    static constexpr auto kTechnology = ValueTable({
        { 0, "LTE"       },
        { 1, "UTRAN"     },
        { 2, "GERAN"     },
        { 3, "CDMA1XRTT" },
        { 4, "CDMAHRPD"  },
    }, "??");

    static constexpr auto kServingCell = record(code::kLTEReselectionCandidates, 21, {
        { 13, u8,              "Version",            decimal            },
        { 15, u16,             "Serving EARFCN",     decimal            },
        { 17, u16,             "Serving Cell ID",    decimal            },
    });
    static constexpr auto kCandidate = entry(12, {  // from 21 on, with what follows by its technology
        {  0, u16,             "Candidate Priority", decimal            },
        {  2, u16,             "Candidate RAT Type", label(kTechnology) },
    });
    static constexpr auto kLte = entry(12, {
        {  4, u16,             "E ARFCN",            decimal            },
        {  6, u16.bits(7, 15), "Cell ID",            decimal            },
    });
    static constexpr auto kUtran = entry(12, {
        {  4, u16,             "U ARFCN",            decimal            },
        {  6, u16,             "PSC",                decimal            },
    });
    static constexpr auto kGeran = entry(12, {
        {  4, u16,             "ARFCN",              decimal            },
        {  6, u8,              "Band",               decimal            },
        {  7, u8,              "BSIC ID",            decimal            },
    });
    static constexpr auto kCdma = entry(12, {
        {  4, u8,              "Band",               decimal            },
        {  8, u16,             "Channel",            decimal            },
        { 10, u16,             "Pilot",              decimal            },
    });
    // clang-format on

    /// Intended: 4 bytes apart, shorter than a candidate, so that the fields of neighbors overlap; and of the number,
    /// 16 bits at 19, the low byte alone.
    static RecordEntries candidates(RecordView record) { return {21, 4, record.count(19, u8)}; }

    /// The fields that only candidates of one technology have.
    static std::span<const Field> fieldsOfTechnology(RecordView record, std::size_t candidate) {
        switch (record.read(candidate + 2, u16)) {
            case 0: return kLte.fields;
            case 1: return kUtran.fields;
            case 2: return kGeran.fields;
            case 3:
            case 4: return kCdma.fields;
            default: return {};
        }
    }
};

}  // namespace kelvo
