#include "tools/export/WideRows.h"

#include <algorithm>

#include "tools/CommandFailure.h"
#include "tools/export/Notation.h"

namespace kelvo {

void WideColumns::write(const Moment&, std::span<const Written> readings) {
    for (const auto& [series, value] : readings) {
        if (series->id >= 0) continue;
        const auto [place, isNew] = _known.emplace(series->path, _paths.size());
        series->id = static_cast<std::int64_t>(place->second);
        if (isNew) _paths.push_back(series->path);
    }
}

WideRows::WideRows(std::vector<std::string> files, OutputThread& output) : _files(std::move(files)), _output(output) {}

void WideRows::write(const Moment& moment, std::span<const Written> readings) {
    if (readings.empty()) return;
    if (!isSameLine(moment, readings)) endLine();
    _moment = moment;
    for (const auto& [series, value] : readings) {
        if (series->id == _line) endLine();  // written twice, by two rows of a list
        series->id = _line;
        _cells.emplace_back(series, cellOf(*value));
    }
}

bool WideRows::isSameLine(const Moment& moment, std::span<const Written> readings) const {
    const bool isSameMoment = moment.time == _moment.time && moment.input == _moment.input;
    return isSameMoment &&
           std::ranges::none_of(readings, [this](const Written& reading) { return reading.series->id == _line; });
}

void WideRows::endLine() {
    if (_cells.empty()) return;
    appendLine(_text, _moment, _time.of(_moment.time), _cells);
    orFail(_output.append(_text));
    _text.clear();
    _cells.clear();
    ++_line;
}

void WideRows::finish() {
    endLine();
    orFail(_output.append(_text));  // the heading, when there was no line
    _text.clear();
    orFail(_output.finish());
}

std::string_view WideRows::fileOf(const Moment& moment) const {
    return hasFiles() ? std::string_view(_files[moment.input]) : std::string_view();
}

WideCsvRows::WideCsvRows(const std::vector<std::string>& columns, std::vector<std::string> files, OutputThread& output)
    : WideRows(std::move(files), output), _line(columns.size()) {
    _text = hasFiles() ? "time,technology,file" : "time,technology";
    for (const std::string& path : columns) {
        _columns.emplace(path, _columns.size());
        _text += ',';
        appendCsvField(_text, path);
    }
    _text += "\r\n";
}

std::string WideCsvRows::cellOf(const Value& value) const {
    std::string cell;
    if (const auto measurement = measurementOf(value)) {
        appendNumber(cell, measurement->number);
    } else {
        appendCsvField(cell, *value.string());
    }
    return cell;
}

void WideCsvRows::appendLine(std::string& out, const Moment& moment, std::string_view time,
                             const std::vector<Cell>& cells) {
    std::ranges::fill(_line, nullptr);
    for (const auto& [series, cell] : cells) {
        const auto column = _columns.find(series->path);
        if (column != _columns.end()) _line[column->second] = &cell;
    }
    out.append(time).append(1, ',').append(namesOf(moment.technology).name);
    if (hasFiles()) appendCsvField(out += ',', fileOf(moment));
    for (const std::string* cell : _line) {
        out += ',';
        if (cell != nullptr) out += *cell;
    }
    out += "\r\n";
}

std::string WideJsonRows::cellOf(const Value& value) const {
    std::string cell;
    if (const auto measurement = measurementOf(value)) {
        appendNumber(cell, measurement->number);
    } else {
        appendJsonString(cell, *value.string());
    }
    return cell;
}

void WideJsonRows::appendLine(std::string& out, const Moment& moment, std::string_view time,
                              const std::vector<Cell>& cells) {
    out.append(R"({"time":")").append(time).append(R"(","technology":")").append(namesOf(moment.technology).name);
    out += '"';
    if (hasFiles()) appendJsonString(out += R"(,"file":)", fileOf(moment));
    for (const auto& [series, cell] : cells) {
        out += ',';
        appendJsonString(out, series->path);
        out.append(1, ':').append(cell);
    }
    out += "}\n";
}

}  // namespace kelvo
