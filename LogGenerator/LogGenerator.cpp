#include "LogGenerator/LogGenerator.h"

#include "LogGenerator/SnapshotFormat.h"
#include "platform/system/DateText.h"
#include "platform/system/Environment.h"

namespace kelvo {

namespace {
constexpr std::size_t kHistoryLimit = 5;
}

void LogGenerator::logCreation() const {
    logLine(Level::Warning, "Creating Log object: %p", static_cast<const void*>(this));
}

void LogGenerator::updateHistoryInState(Dictionary& state) {
    ArrayRef history = state["History"].array();
    if (!history) {
        history = Array::make();
        state.set("History", history);
    } else if (history->size() >= kHistoryLimit) {
        history->removeFirst(history->size() - (kHistoryLimit - 1));
    }

    // The list of pairs ends at the first value that is absent: without a "DisplayState" the snapshot is empty.
    const DictionaryRef taken = Dictionary::make();
    bool complete = true;
    for (const Key key : {Key(snapshot::kDisplayState), Key(snapshot::kDisplay), Key(snapshot::kExtraInfo)}) {
        const Value& value = state[key];
        complete = complete && static_cast<bool>(value);
        if (complete) taken->set(key, value.copy());
    }
    if (complete) {
        const std::string date = dateDescription(clock().now());
        taken->set(snapshot::kDate, date);
        taken->set(snapshot::kDescription, "Snapshot (" + date + ")");
    }
    history->append(taken);
}

}  // namespace kelvo
