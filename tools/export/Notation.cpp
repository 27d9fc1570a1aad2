#include "tools/export/Notation.h"

#include <csv.h>
#include <fmt/format.h>

#include <cmath>
#include <iterator>

#include "platform/encodings/Utf8.h"
#include "tools/DisplayJson.h"

namespace kelvo {

namespace {

constexpr std::string_view kUnreadable = "\xEF\xBF\xBD";  // U+FFFD

bool hasSeveral(const std::vector<std::string>& files) { return files.size() > 1; }

class CsvNotation final : public Notation {
public:
    explicit CsvNotation(std::vector<std::string> files) : _files(std::move(files)) {}

    std::string heading() const override {
        return std::string("time,technology,path,text,number,unit,code,record") + (hasSeveral(_files) ? ",file" : "") +
               "\r\n";
    }
    void appendStart(std::string& out, const Moment& moment, std::string_view time) const override {
        out.append(time).append(1, ',').append(namesOf(moment.technology).name).append(1, ',');
    }
    void appendSeries(std::string& out, const Series& series) const override { appendCsvField(out, series.path); }
    void appendReading(std::string& out, const std::string& text,
                       const std::optional<Measurement>& measurement) const override {
        out += ',';
        appendCsvField(out, text);
        out += ',';
        if (measurement) appendNumber(out, measurement->number);
        out += ',';
        if (measurement) out += measurement->unit;
    }
    void appendEnd(std::string& out, const Moment& moment) const override {
        out += ',';
        if (moment.code) out += codeText(*moment.code);
        out += ',';
        out += fmt::format_int(moment.record).str();
        if (hasSeveral(_files)) {
            out += ',';
            appendCsvField(out, _files[moment.input]);
        }
        out += "\r\n";
    }

private:
    std::vector<std::string> _files;
};

class JsonNotation final : public Notation {
public:
    explicit JsonNotation(std::vector<std::string> files) : _files(std::move(files)) {}

    void appendStart(std::string& out, const Moment& moment, std::string_view time) const override {
        out.append(R"({"time":")").append(time);
        out.append(R"(","technology":")").append(namesOf(moment.technology).name).append(R"(",)");
    }
    void appendSeries(std::string& out, const Series& series) const override {
        out += R"("path":)";
        appendJsonString(out, series.path);
    }
    void appendReading(std::string& out, const std::string& text,
                       const std::optional<Measurement>& measurement) const override {
        out += R"(,"text":)";
        appendJsonString(out, text);
        if (!measurement) return;
        out += R"(,"number":)";
        appendNumber(out, measurement->number);
        if (measurement->unit.empty()) return;
        out += R"(,"unit":)";
        appendJsonString(out, measurement->unit);
    }
    void appendEnd(std::string& out, const Moment& moment) const override {
        if (moment.code) out.append(R"(,"code":")").append(codeText(*moment.code)).append(1, '"');
        out.append(R"(,"record":)").append(fmt::format_int(moment.record).str());
        if (hasSeveral(_files)) {
            out += R"(,"file":)";
            appendJsonString(out, _files[moment.input]);
        }
        out += "}\n";
    }

private:
    std::vector<std::string> _files;
};

/// Text that ends where the line protocol's own signs are: the protocol has no way to write a control character, nor a
/// tag that ends in a backslash.
std::string escaped(std::string_view text, std::string_view signs) {
    const std::string clean = printable(text);
    std::string escaped;
    for (const char c : clean) {
        if (signs.find(c) != signs.npos) escaped += '\\';
        escaped += c;
    }
    return escaped;
}

std::string tag(std::string_view text) {
    std::string tag = escaped(text, ",= ");
    if (tag.ends_with('\\')) tag.replace(tag.size() - 1, 1, kUnreadable);
    return tag.empty() ? std::string(kUnreadable) : tag;
}

class InfluxNotation final : public Notation {
public:
    explicit InfluxNotation(std::vector<std::string> files) : _files(std::move(files)) {}

    // Tags in the order of their names, as databases like them best.
    void appendStart(std::string& out, const Moment& moment, std::string_view) const override {
        out += "reading";
        if (moment.code) out.append(",code=").append(codeText(*moment.code));
        if (hasSeveral(_files)) out.append(",file=").append(tag(_files[moment.input]));
    }
    void appendSeries(std::string& out, const Series& series) const override {
        out.append(",path=").append(tag(series.path));
        out.append(",technology=").append(namesOf(series.technology).name);
    }
    void appendReading(std::string& out, const std::string& text,
                       const std::optional<Measurement>& measurement) const override {
        if (measurement && !measurement->unit.empty()) out.append(",unit=").append(tag(measurement->unit));
        out.append(" text=\"").append(escaped(text, "\"\\")).append(1, '"');
        if (!measurement) return;
        out += ",number=";
        appendNumber(out, measurement->number);
    }
    void appendEnd(std::string& out, const Moment& moment) const override {
        out.append(",record=").append(fmt::format_int(moment.record).str());
        out.append("i ").append(fmt::format_int(moment.time.time_since_epoch().count()).str()).append(1, '\n');
    }

private:
    std::vector<std::string> _files;
};

}  // namespace

std::unique_ptr<Notation> csvNotation(std::vector<std::string> files) {
    return std::make_unique<CsvNotation>(std::move(files));
}
std::unique_ptr<Notation> jsonNotation(std::vector<std::string> files) {
    return std::make_unique<JsonNotation>(std::move(files));
}
std::unique_ptr<Notation> influxNotation(std::vector<std::string> files) {
    return std::make_unique<InfluxNotation>(std::move(files));
}

std::optional<Measurement> measurementOf(const Value& value) {
    const auto measurement = value.measurement();
    return measurement && std::isfinite(measurement->number) ? measurement : std::nullopt;
}

void appendCleanText(std::string& out, std::string_view text) {
    std::size_t at = out.size();
    appendCleanUtf8(out, text);
    while ((at = out.find('\0', at)) != out.npos) out.replace(at, 1, kUnreadable);
}

void appendCsvField(std::string& out, std::string_view text) {
    std::string clean;
    appendCleanText(clean, text);
    const std::size_t before = out.size();
    out.resize(before + 2 * clean.size() + 2);
    out.resize(before + csv_write(out.data() + before, out.size() - before, clean.data(), clean.size()));
}

void appendJsonString(std::string& out, std::string_view text) { out += printedJsonLine(std::string(text)); }

void appendNumber(std::string& out, double number) { fmt::format_to(std::back_inserter(out), "{}", number); }

std::string codeText(LogCode code) { return fmt::format("0x{:04x}", code); }

}  // namespace kelvo
