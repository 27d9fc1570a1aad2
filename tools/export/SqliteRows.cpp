#include "tools/export/SqliteRows.h"

#include <fmt/format.h>

#include <utility>

#include "glossary/Glossary.h"
#include "tools/CommandFailure.h"
#include "tools/export/Notation.h"

namespace kelvo {

namespace {

constexpr const char* kTables = R"(
BEGIN;
CREATE TABLE capture (
    id INTEGER PRIMARY KEY,
    file TEXT NOT NULL,
    technology TEXT NOT NULL,
    records INTEGER NOT NULL,    -- how many were read
    first TEXT,                  -- the time of the first, ISO 8601, UTC
    last TEXT,
    breaks_off TEXT              -- where and why; NULL when it was read to its end
);
CREATE TABLE value (
    id INTEGER PRIMARY KEY,
    technology TEXT NOT NULL,
    path TEXT NOT NULL,          -- "/Serving Cell Measurements/Measured RSRP"
    unit TEXT,                   -- "dBm"; empty for plain numbers; NULL where no number was read
    meaning TEXT,                -- one sentence
    standard TEXT,               -- where it is written
    UNIQUE (technology, path, unit)
);
CREATE TABLE reading (
    capture INTEGER NOT NULL REFERENCES capture,
    value INTEGER NOT NULL REFERENCES value,
    time TEXT NOT NULL,          -- the record's own, ISO 8601, UTC, with microseconds
    text TEXT NOT NULL,          -- as the screens show it
    number REAL,                 -- NULL for a text that is no number
    code TEXT,                   -- of the record: "0xb17f"
    record INTEGER NOT NULL      -- its number in its capture, from 1
);
CREATE VIEW readings AS
    SELECT time, value.technology, path, text, number,
           CASE WHEN number IS NULL THEN '' ELSE unit END AS unit, code, record, file
    FROM reading JOIN value ON value.id = reading.value JOIN capture ON capture.id = reading.capture;
)";

constexpr const char* kIndexes = R"(
CREATE INDEX reading_by_value ON reading (value, time);
CREATE INDEX reading_by_time ON reading (time);
CREATE INDEX value_by_path ON value (path);
COMMIT;
)";

}  // namespace

struct SqliteRows::Statements {
    explicit Statements(const Database& database)
        : addReading(database,
                     "INSERT INTO reading (capture, value, time, text, number, code, record) "
                     "VALUES (?, ?, ?, ?, ?, ?, ?)"),
          addValue(database,
                   "INSERT INTO value (technology, path, unit, meaning, standard) VALUES (?, ?, ?, ?, ?) RETURNING id"),
          // The row of that unit, or else one that has not met a number yet; for a text any row.
          findValue(database,
                    "SELECT id, unit FROM value WHERE technology = ?1 AND path = ?2 AND "
                    "(?3 IS NULL OR unit = ?3 OR unit IS NULL) ORDER BY unit = ?3 DESC LIMIT 1"),
          setUnit(database, "UPDATE value SET unit = ?2 WHERE id = ?1"),
          addCapture(database,
                     "INSERT INTO capture (id, file, technology, records, first, last, breaks_off) "
                     "VALUES (?, ?, ?, ?, ?, ?, ?)") {}

    Database::Statement addReading;
    Database::Statement addValue;
    Database::Statement findValue;
    Database::Statement setUnit;
    Database::Statement addCapture;
};

SqliteRows::SqliteRows(OutputFile file) : _file(std::move(file)), _database(_file.path(), orFail(_file.place())) {
    _database.run(kTables);
    _statements = std::make_unique<Statements>(_database);
}

SqliteRows::~SqliteRows() = default;

void SqliteRows::write(const Moment& moment, std::span<const Written> readings) {
    if (readings.empty()) return;
    const std::string_view time = _time.of(moment.time);
    const std::string code = moment.code ? codeText(*moment.code) : std::string();
    Database::Statement& add = _statements->addReading;
    for (const auto& [series, value] : readings) {
        const auto measurement = measurementOf(*value);
        _text.clear();
        appendCleanText(_text, *value->string());
        add.bind(1, static_cast<std::int64_t>(moment.input + 1))
            .bind(2, valueOf(*series, measurement))
            .bind(3, time)
            .bind(4, std::string_view(_text));
        if (measurement) add.bind(5, measurement->number);
        if (moment.code) add.bind(6, std::string_view(code));
        add.bind(7, static_cast<std::int64_t>(moment.record)).step();
    }
}

std::int64_t SqliteRows::valueOf(Series& series, const std::optional<Measurement>& measurement) {
    std::string& known = series.rendered;  // the unit of the row that the series has, in brackets; empty for NULL
    const std::string unit = measurement ? fmt::format("[{}]", measurement->unit) : std::string();
    if (series.id >= 0 && (!measurement || known == unit)) return series.id;
    std::string path;
    appendCleanText(path, series.path);
    const std::string_view technology = namesOf(series.technology).name;
    Database::Statement& find = _statements->findValue;
    find.bind(1, technology).bind(2, std::string_view(path));
    if (measurement) find.bind(3, measurement->unit);
    if (find.step()) {
        series.id = find.integer(0);
        known = find.isNull(1) ? std::string() : fmt::format("[{}]", find.text(1));
        find.reset();
        if (!measurement || known == unit) return series.id;
        _statements->setUnit.bind(1, series.id).bind(2, measurement->unit).step();
    } else {
        Database::Statement& add = _statements->addValue;
        add.bind(1, technology).bind(2, std::string_view(path));
        if (measurement) add.bind(3, measurement->unit);
        if (const Meaning* meaning = meaningAt(series.technology, series.path)) {
            add.bind(4, meaning->sentence).bind(5, standardOf(*meaning));
        }
        add.step();
        series.id = add.integer(0);
        add.step();
    }
    known = unit;
    return series.id;
}

void SqliteRows::endInput(const ReadInput& input) {
    std::string file;
    appendCleanText(file, input.name);
    MomentText text;
    const std::string first = input.first ? std::string(text.of(*input.first)) : std::string();
    const std::string last = input.last ? std::string(text.of(*input.last)) : std::string();
    Database::Statement& add = _statements->addCapture;
    add.bind(1, static_cast<std::int64_t>(input.number + 1))
        .bind(2, std::string_view(file))
        .bind(3, namesOf(input.technology).name)
        .bind(4, static_cast<std::int64_t>(input.records));
    if (input.first) add.bind(5, std::string_view(first));
    if (input.last) add.bind(6, std::string_view(last));
    if (!input.breakOff.empty()) add.bind(7, std::string_view(input.breakOff));
    add.step();
}

void SqliteRows::finish() {
    _statements.reset();
    _database.run(kIndexes);
    _database.close();
    orFail(_file.appear());
}

}  // namespace kelvo
