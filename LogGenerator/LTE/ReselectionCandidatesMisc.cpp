#include "LogGenerator/LTE/ReselectionCandidatesMisc.h"

#include "LogGenerator/LTE/ReselectionCandidatesRecord.h"
#include "platform/system/Environment.h"

namespace kelvo {

void ReselectionCandidatesMisc::updateWithData(ByteView data, LogCode logCode) {
    logLine(Level::Warning, "Reselection Candidates");
    showOneOf(data, logCode, ReselectionCandidatesRecord::kServingCell);
}

}  // namespace kelvo
