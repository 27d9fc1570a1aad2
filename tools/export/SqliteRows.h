#pragma once

#include <optional>
#include <string>
#include <string_view>

#include "platform/system/OutputFile.h"
#include "tools/export/Database.h"
#include "tools/export/Moment.h"
#include "tools/export/ReadingRows.h"

namespace kelvo {

/// A database with the tables `capture` (what was read), `value` (what every path means) and `reading`, and the view
/// `readings`, which puts them together.
class SqliteRows final : public ReadingRows {
public:
    explicit SqliteRows(OutputFile file);
    ~SqliteRows() override;

    void write(const Moment& moment, std::span<const Written> readings) override;
    void endInput(const ReadInput& input) override;
    void finish() override;

private:
    struct Statements;

    std::int64_t valueOf(Series& series, const std::optional<Measurement>& measurement);

    OutputFile _file;
    Database _database;
    std::unique_ptr<Statements> _statements;
    MomentText _time;
    std::string _text;
};

}  // namespace kelvo
