#pragma once

#include <cstdint>
#include <deque>
#include <string>

#include "overview/Tracker.h"
#include "tools/report/Drive.h"

namespace kelvo::report {

/// Follows the overview from record to record and keeps what a report tells.
class DriveRecorder {
public:
    explicit DriveRecorder(Drive& drive) : _drive(drive) {}

    /// What the tracker says after the record `number`, which is `at` in the recording and bears the time `now`.
    /// `at` does not go back.
    void note(const overview::Tracker& tracker, std::uint64_t number, Elapsed at, overview::Time now);
    /// What follows is not connected with what was before: there is a pause.
    void interrupt();
    /// The recording ends there.
    void end(const overview::Tracker& tracker, Elapsed at);

private:
    void noteServing(const overview::Observation& seen, Elapsed at);
    void noteLevels(const overview::Observation& seen, Elapsed at);
    void noteNeighbors(const overview::Tracker& tracker, std::uint64_t number, Elapsed at, overview::Time now);
    void noteRates(const overview::Observation& seen, std::uint64_t number, Elapsed at);
    void noteEvents(const overview::Tracker& tracker, Elapsed at);
    void keepOldestEvent(const overview::Tracker& tracker);
    void noteLanes(const overview::Observation& seen, Elapsed at);

    Drive& _drive;
    std::string _access;
    std::string _cell;
    CellFigures* _serving = nullptr;
    Elapsed _servingSince{0};
    std::uint64_t _levelRecord = 0;
    std::uint64_t _qualityRecord = 0;
    std::deque<Elapsed> _eventTimes;  // of those that are not in the drive yet
    std::uint64_t _eventCount = 0;
};

}  // namespace kelvo::report
