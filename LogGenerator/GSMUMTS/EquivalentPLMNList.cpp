#include "LogGenerator/GSMUMTS/EquivalentPLMNList.h"

#include "LogGenerator/RowWriter.h"
#include "platform/system/Environment.h"

namespace kelvo {

namespace {

/// Entries start 3 bytes apart and take 6 bytes each, every other byte a digit of one of the two codes: they overlap,
/// as intended.
void showNetwork(Dictionary::Rewrite& network, RecordView record, std::size_t at) {
    const auto number = [&](std::size_t from) {
        return record.read(from, u8) * 100 + record.read(from + 2, u8) * 10 + record.read(from + 4, u8);
    };
    showValue(network.next("Mobile Country Code"), number(at), decimal);
    showValue(network.next("Mobile Network Code"), number(at + 1), decimal);
}

}  // namespace

void EquivalentPLMNList::updateWithData(ByteView data, LogCode logCode) {
    logLine(Level::Warning, "Equivalent PLMN List");
    if (logCode != code::kEquivalentPLMNs) return reportUnknown(logCode);
    if (data.size() < 17) return;
    const RecordView record(data);
    const auto count = record.count(16, u8);
    const RecordEntries entries = RecordEntries(17, 3, count).within(data.size());
    RowWriter rows(list());
    for (std::size_t i = 0; i < entries.count(); ++i) {
        Dictionary::Rewrite network = rows.next();
        showNetwork(network, record, entries.offsetOf(i));
    }
}

}  // namespace kelvo
