#include "LogGenerator/LTE/ReselectionCandidatesList.h"

#include "LogGenerator/LTE/ReselectionCandidatesRecord.h"
#include "LogGenerator/RowWriter.h"
#include "platform/system/Environment.h"

namespace kelvo {

void ReselectionCandidatesList::updateWithData(ByteView data, LogCode logCode) {
    logLine(Level::Warning, "Reselection Candidates List");
    using Layout = ReselectionCandidatesRecord;
    if (logCode != code::kLTEReselectionCandidates) return reportUnknown(logCode);
    if (data.size() < Layout::kServingCell.size) return;
    const RecordView record(data);
    const RecordEntries candidates = Layout::candidates(record).within(data.size());
    RowWriter rows(list());
    for (std::size_t i = 0; i < candidates.count(); ++i) {
        const std::size_t at = candidates.offsetOf(i);
        Dictionary::Rewrite row = rows.next();
        showFields(row, record, at, Layout::kCandidate.fields);
        showFields(row, record, at, Layout::fieldsOfTechnology(record, at));
    }
}

}  // namespace kelvo
