#pragma once

#include <map>
#include <optional>
#include <string>
#include <vector>

#include "LogGenerator/LogCode.h"
#include "overview/Event.h"
#include "platform/telephony/Technology.h"
#include "tools/report/Distribution.h"
#include "tools/report/Lane.h"
#include "tools/report/RecordedTime.h"
#include "tools/report/ThinnedSeries.h"

namespace kelvo::report {

/// Something that is measured: a level, a quality, a throughput or an error rate.
struct MeasureFigures {
    std::string name;  ///< "RSRP", "Traffic FER"
    std::string unit;  ///< "dBm"; empty for a plain number
    bool isQuality = false;
    Distribution readings;
    ThinnedSeries series;
    ThinnedSeries bestNeighbor;  ///< the strongest of the cells around, where they have this
};

/// A cell in whichever part it was seen.
struct CellFigures {
    std::string access;
    std::string band;
    std::string area;
    std::string network;
    std::string mark;       ///< of a neighbor: "candidate", "detected"
    std::string levelName;  ///< what `level` is: "RSRP"
    std::string levelUnit;
    Distribution level;
    std::string qualityName;
    std::string qualityUnit;
    Distribution quality;
    Elapsed first{0};
    Elapsed last{0};
    Elapsed served{0};           ///< as the serving cell
    std::uint64_t visits = 0;    ///< how often it began to serve
    std::uint64_t heard = 0;     ///< as a neighbor: by how many records
    std::uint64_t stronger = 0;  ///< in how many of them it was above the serving cell
};

/// Cells by their identities, the first ten thousand of them.
struct CellTable {
    static constexpr std::size_t kMost = 10'000;
    std::map<std::string, CellFigures> cells;
    std::uint64_t beyond = 0;  ///< times that a further one was met
    /// None where there is no room for another.
    CellFigures* at(const std::string& identity);
};

struct NamedLane {
    std::string name;
    Lane lane;
};

struct DriveEvent {
    Elapsed at;
    overview::Event event;
};

/// Where another cell began to serve.
struct CellChange {
    Elapsed at;
    bool isHandover;
};

/// Records of one code that Kelvo could not read.
struct UnreadCode {
    std::uint64_t records = 0;
    std::uint64_t strange = 0;  ///< of no code that the technology's screens take
    std::uint64_t silent = 0;   ///< of such a code, and nothing on the screens came of it
};

/// What one recording has to tell.
struct Drive {
    static constexpr std::size_t kMostEvents = 1000;

    std::string name;  ///< of the file
    Technology technology{};
    std::uint64_t records = 0;
    bool isByRecords = false;  ///< there are no times: a record stands for a second
    RecordedTime time;
    Elapsed length{0};
    std::vector<MeasureFigures> levels;  ///< levels and qualities
    std::vector<MeasureFigures> rates;
    CellTable serving;
    CellTable neighbors;
    std::vector<NamedLane> lanes;    ///< radio, network, cell, state, registration, service, contexts
    std::vector<DriveEvent> events;  ///< the first `kMostEvents`
    std::map<overview::Event::Kind, std::uint64_t> counts;  ///< of all
    std::vector<CellChange> changes;                        ///< likewise
    std::map<LogCode, UnreadCode> codes;
    std::vector<std::string> remarks;  ///< where the file breaks off, and what else of it could not be read

    const Lane* lane(std::string_view name) const;
    std::uint64_t count(overview::Event::Kind kind) const;
    std::uint64_t eventCount() const;
};

}  // namespace kelvo::report
