#include "LogGenerator/GSMUMTS/EquivalentPLMNList.h"

#include "platform/Environment.h"

namespace kelvo {

namespace {

/// Entries start 3 bytes apart and take 6 bytes each, every other byte a digit of one of the two codes: they overlap,
/// as intended.
Value networkAt(RecordView record, std::size_t at) {
    const auto number = [&](std::size_t from) {
        return record.read(from, u8) * 100 + record.read(from + 2, u8) * 10 + record.read(from + 4, u8);
    };
    const DictionaryRef network = Dictionary::make();
    print(network->slot("Mobile Country Code").text(), number(at), decimal);
    print(network->slot("Mobile Network Code").text(), number(at + 1), decimal);
    return network;
}

}  // namespace

void EquivalentPLMNList::updateWithData(ByteView data, LogCode logCode) {
    logLine(Level::Warning, "Equivalent PLMN List");
    if (logCode != 0x7150) return reportUnknown(logCode);
    if (data.size() < 17) return;
    clearElementsInArray(list());
    const RecordView record(data);
    const RecordEntries entries(17, 3, static_cast<std::size_t>(record.read(16, u8)));
    std::vector<Value> networks;
    for (std::size_t i = 0; i < entries.count() && entries.offsetOf(i) < data.size(); ++i) {
        networks.push_back(networkAt(record, entries.offsetOf(i)));
    }
    if (entries.count() > 0) replaceArray(list(), std::move(networks));
}

}  // namespace kelvo
