#include "tools/SnapshotCapture.h"

#include <fmt/format.h>

#include <limits>
#include <optional>
#include <utility>

#include "platform/encodings/PropertyList.h"
#include "platform/host/Capture.h"
#include "platform/system/DateText.h"
#include "tools/CommandFailure.h"
#include "tools/RawRecords.h"

namespace kelvo {

namespace {

constexpr std::chrono::seconds kRefresh{2};

/// The date of an entry; none when there is none, it reads otherwise or lies outside the
/// 32 bits that a capture has for its seconds.
std::optional<CaptureTime> timeOf(const SnapshotFile::Entry& entry) {
    const auto date = entry.date ? dateFromDescription(*entry.date) : std::nullopt;
    if (!date) return std::nullopt;
    const std::chrono::seconds since1970 = date->time_since_epoch();
    constexpr std::chrono::seconds kLast(std::numeric_limits<std::uint32_t>::max());
    if (since1970 < since1970.zero() || since1970 > kLast) return std::nullopt;
    return CaptureTime(since1970);
}

/// The messages of one entry; what is odd about them goes to `odd`.
std::vector<Bytes> messagesOf(const SnapshotFile::Entry& entry, bool asTree, const std::string& where,
                              std::vector<std::string>& odd) {
    const Value& state = entry.displayState;
    if (!state) return {};
    if (asTree) {  // a cell monitor's message is the tree itself
        const Result<Bytes> message = writeXmlPropertyList(state);
        if (message) return {*message};
        odd.push_back(where + ": " + message.error().reason);
        return {};
    }
    if (state.data() == nullptr) {
        odd.push_back(fmt::format("{} has a {} as \"DisplayState\", not raw records", where, kindName(state.kind())));
        return {};
    }
    const RawRecords records = splitRawRecords(*state.data());
    if (records.leftOver != 0) {
        odd.push_back(fmt::format("{} ends in {} bytes that form no whole record", where, records.leftOver));
    }
    std::vector<Bytes> messages;
    for (ByteView message : records.messages) messages.emplace_back(message.begin(), message.end());
    return messages;
}

}  // namespace

std::vector<SnapshotMessage> messagesOf(const SnapshotFile& snapshot, bool asTrees, std::vector<std::string>& odd) {
    std::vector<SnapshotMessage> all;
    CaptureTime end{};
    for (std::size_t i = 0; i < snapshot.entries.size(); ++i) {
        const SnapshotFile::Entry& entry = snapshot.entries[i];
        auto messages = messagesOf(entry, asTrees, fmt::format("entry {}", i + 1), odd);
        end = std::max(end + kRefresh, timeOf(entry).value_or(CaptureTime()));
        for (std::size_t m = 0; m < messages.size(); ++m) {
            const std::chrono::nanoseconds before =
                std::chrono::nanoseconds(kRefresh) * (messages.size() - m) / static_cast<long>(messages.size());
            all.push_back({end - before, std::move(messages[m])});
        }
    }
    return all;
}

std::size_t writeSnapshotCapture(const SnapshotFile& snapshot, Technology technology, OutputFile file,
                                 std::vector<std::string>& odd) {
    const auto messages = messagesOf(snapshot, !hasCodes(technology), odd);
    if (messages.empty()) throw CommandFailure("the snapshot holds no raw records");
    CaptureWriter writer = orFail(CaptureWriter::create(std::move(file), technology));
    for (const SnapshotMessage& message : messages) orFail(writer.append(message.time, message.bytes));
    orFail(writer.appear());
    return messages.size();
}

}  // namespace kelvo
