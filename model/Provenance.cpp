#include "model/Provenance.h"

#include "LogGenerator/CodeNames.h"

namespace kelvo {

std::optional<Provenance> provenanceOf(std::uint64_t record, const RecordLedger& ledger, std::chrono::nanoseconds now) {
    const RecordLedger::Entry* entry = ledger.find(record);
    if (entry == nullptr) return std::nullopt;
    Provenance provenance{.record = record,
                          .code = {},
                          .modemTime = timeOf(entry->timestamp),
                          .arrival = entry->arrival,
                          .stream = entry->stream,
                          .age = ledger.streamTime(now) - entry->stream,
                          .place = {},
                          .bytes = ledger.bytesOf(*entry)};
    if (entry->code != 0) provenance.code = entry->code;
    return provenance;
}

std::string describe(const Provenance& provenance) {
    return provenance.code ? describeCode(*provenance.code) : std::string();
}

}  // namespace kelvo
