#include "tools/report/FollowDrive.h"

#include <fmt/format.h>

#include <filesystem>
#include <limits>

#include "tools/CapturePackets.h"
#include "tools/FamilyCodes.h"
#include "tools/QuietDecoder.h"
#include "tools/report/DriveRecorder.h"
#include "tools/report/Words.h"

namespace kelvo::report {
namespace {

constexpr auto kRecord = std::chrono::seconds(1);  // what a record stands for where there are no times

/// Keeps the figures by time and, as long as every record has the same, by the number of the record as well.
class BothClocks {
public:
    void note(const overview::Tracker& tracker, overview::Time time) {
        ++_records;
        const std::uint64_t pauses = _byTime.time.pauses();
        const Elapsed at = _byTime.time.note(time);
        if (_byTime.time.pauses() != pauses) _timed.interrupt();
        _timed.note(tracker, _records, at, time);
        if (_byTime.time.isTimeless()) _counted.note(tracker, _records, (_records - 1) * kRecord, time);
    }

    Drive end(const overview::Tracker& tracker) {
        const bool isByRecords = _records > 1 && _byTime.time.isTimeless();
        Drive& drive = isByRecords ? _byRecord : _byTime;
        (isByRecords ? _counted : _timed).end(tracker, isByRecords ? _records * kRecord : _byTime.time.length());
        drive.isByRecords = isByRecords;
        drive.time = _byTime.time;
        drive.records = _records;
        return std::move(drive);
    }

private:
    Drive _byTime;
    Drive _byRecord;
    DriveRecorder _timed{_byTime};
    DriveRecorder _counted{_byRecord};
    std::uint64_t _records = 0;
};

/// The records that Kelvo could not read, code by code.
class Unread {
public:
    explicit Unread(LogGenerator& generator) : _codes(*generator.getStartCommand()) {}

    void note(const RecordLedger& ledger, ByteView message) {
        const RecordLedger::Entry* entry = ledger.find(ledger.count());
        if (entry == nullptr || entry->code == 0) return;
        UnreadCode& code = _unread[entry->code];
        ++code.records;
        if (!_codes.include(message)) {
            ++code.strange;
        } else if (ledger.bytesOf(*entry).empty()) {
            ++code.silent;
        }
    }

    std::map<LogCode, UnreadCode> take() {
        std::erase_if(_unread, [](const auto& code) { return code.second.strange + code.second.silent == 0; });
        return std::move(_unread);
    }

private:
    FamilyCodes _codes;
    std::map<LogCode, UnreadCode> _unread;
};

/// Where a file lies is nothing for those who get the report.
std::string withoutFolder(std::string sentence, const std::string& path, const std::string& name) {
    if (const std::size_t place = sentence.find(path); !path.empty() && place != sentence.npos) {
        sentence.replace(place, path.size(), name);
    }
    return sentence;
}

}  // namespace

Drive followDrive(Input& input, RecordSharer* sharer, const std::function<void()>& afterEach) {
    const Technology technology = input.technology();
    const QuietDecoder decoder(technology);
    RecordLedger records;
    overview::Tracker tracker({.events = 2000, .span = overview::Time::duration::max()});
    BothClocks clocks;
    Unread unread(decoder.generator());
    std::uint64_t leftOut = 0;
    while (const auto packet = input.next()) {
        afterEach();
        ByteView message = packet->bytes;
        CaptureTime clock = packet->time;
        if (sharer != nullptr) {
            clock = sharer->times().host(clock);
            const auto shared = sharer->share(message, technology);
            if (!shared) {
                ++leftOut;
                continue;
            }
            message = *shared;
        }
        const auto time = std::chrono::floor<std::chrono::microseconds>(clock);
        orTell(input.name(), input.count(),
               [&] { update(decoder.generator(), decoder.state(), records, message, clock.time_since_epoch()); });
        tracker.note(overview::observe(technology, decoder.display()), time);
        clocks.note(tracker, time);
        unread.note(records, message);
    }
    Drive drive = clocks.end(tracker);
    drive.name = std::filesystem::path(input.name()).filename().string();
    drive.technology = technology;
    drive.codes = unread.take();
    if (sharer != nullptr) {
        drive.name = "shared recording";
        if (leftOut != 0)
            drive.remarks.push_back(counted(leftOut, "record") + " left out: Kelvo cannot look into them.");
        if (input.breakOff()) drive.remarks.emplace_back("The recording breaks off; what comes before is told of.");
        return drive;
    }
    if (input.breakOff()) drive.remarks.push_back(withoutFolder(input.breakOff()->reason, input.name(), drive.name));
    for (const std::string& sentence : input.leftOut()) {
        drive.remarks.push_back(withoutFolder(sentence, input.name(), drive.name));
    }
    return drive;
}

}  // namespace kelvo::report
