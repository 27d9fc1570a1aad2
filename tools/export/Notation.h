#pragma once

#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "platform/values/Reading.h"
#include "tools/export/Moment.h"
#include "tools/export/Series.h"

namespace kelvo {

/// How a row of text is written: four parts one after the other. The same record, path and reading always give the same
/// part, so that each is made once and put together a million times.
class Notation {
public:
    virtual ~Notation() = default;

    /// What stands before the first row.
    virtual std::string heading() const { return {}; }
    virtual void appendStart(std::string& out, const Moment& moment, std::string_view time) const = 0;
    virtual void appendSeries(std::string& out, const Series& series) const = 0;
    virtual void appendReading(std::string& out, const std::string& text,
                               const std::optional<Measurement>& measurement) const = 0;
    virtual void appendEnd(std::string& out, const Moment& moment) const = 0;
};

/// Comma-separated values after RFC 4180. `files`: the inputs' names; a column tells them where there are several.
std::unique_ptr<Notation> csvNotation(std::vector<std::string> files);
/// One JSON object a line.
std::unique_ptr<Notation> jsonNotation(std::vector<std::string> files);
/// The line protocol of time series databases.
std::unique_ptr<Notation> influxNotation(std::vector<std::string> files);

/// The number of a reading in its unit; none for a text that is no number, and for one that no notation can write.
std::optional<Measurement> measurementOf(const Value& value);

/// Bytes that are not UTF-8, and NUL, at which many readers end a text, become U+FFFD.
void appendCleanText(std::string& out, std::string_view text);
/// A clean text in quotes, as a CSV field.
void appendCsvField(std::string& out, std::string_view text);
/// A JSON string. Bytes that are not UTF-8 become U+FFFD; what a terminal would obey is escaped.
void appendJsonString(std::string& out, std::string_view text);
/// The shortest form that reads back the same: "-95.25", "12".
void appendNumber(std::string& out, double number);
/// "0xb17f".
std::string codeText(LogCode code);

}  // namespace kelvo
