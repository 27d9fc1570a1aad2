#pragma once

#include <string>
#include <unordered_map>
#include <utility>
#include <vector>

#include "tools/export/OutputThread.h"
#include "tools/export/ReadingRows.h"

namespace kelvo {

/// The paths of readings, in the order in which they came first: the columns of a table.
class WideColumns final : public ReadingRows {
public:
    void write(const Moment& moment, std::span<const Written> readings) override;
    void finish() override {}

    const std::vector<std::string>& paths() const { return _paths; }

private:
    std::unordered_map<std::string, std::size_t> _known;
    std::vector<std::string> _paths;
};

/// One line a moment: what the records of the same time have written. A number stands by itself, anything else as its
/// text; what was not written at that moment is left empty.
class WideRows : public ReadingRows {
public:
    /// `output` outlives it; `files` are the inputs' names.
    WideRows(std::vector<std::string> files, OutputThread& output);

    void write(const Moment& moment, std::span<const Written> readings) final;
    void letSeriesGo() final { endLine(); }
    void finish() final;

protected:
    using Cell = std::pair<Series*, std::string>;

    /// A value as a cell.
    virtual std::string cellOf(const Value& value) const = 0;
    virtual void appendLine(std::string& out, const Moment& moment, std::string_view time,
                            const std::vector<Cell>& cells) = 0;
    /// The name of the input that the moment is of; empty when there is but one.
    std::string_view fileOf(const Moment& moment) const;
    bool hasFiles() const { return _files.size() > 1; }

    std::string _text;  // to be written next

private:
    void endLine();
    bool isSameLine(const Moment& moment, std::span<const Written> readings) const;

    std::vector<std::string> _files;
    OutputThread& _output;
    MomentText _time;
    Moment _moment;  // of the line
    std::vector<Cell> _cells;
    std::int64_t _line = 0;  // its number, which the series in it bear
};

/// With a column for each of the paths, and a heading that names them.
class WideCsvRows final : public WideRows {
public:
    WideCsvRows(const std::vector<std::string>& columns, std::vector<std::string> files, OutputThread& output);

private:
    std::string cellOf(const Value& value) const override;
    void appendLine(std::string& out, const Moment& moment, std::string_view time,
                    const std::vector<Cell>& cells) override;

    std::unordered_map<std::string, std::size_t> _columns;
    std::vector<const std::string*> _line;
};

/// An object a line, which has its paths as keys.
class WideJsonRows final : public WideRows {
public:
    using WideRows::WideRows;

private:
    std::string cellOf(const Value& value) const override;
    void appendLine(std::string& out, const Moment& moment, std::string_view time,
                    const std::vector<Cell>& cells) override;
};

}  // namespace kelvo
