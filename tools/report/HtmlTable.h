#pragma once

#include <string>
#include <vector>

namespace kelvo::report {

/// One cell of a table. Texts are escaped when the table is written.
struct TableCell {
    std::string text;
    std::string key = {};  ///< by which it sorts, a number; empty for by its text
};

/// A table of a report: with a caption, headings for columns and rows, and what its script needs to sort it.
class HtmlTable {
public:
    enum class Kind { Text, Number };
    struct Column {
        std::string title;
        Kind kind = Kind::Number;
    };

    HtmlTable(std::string caption, std::vector<Column> columns)
        : _caption(std::move(caption)), _columns(std::move(columns)) {}

    void add(std::vector<TableCell> row) { _rows.push_back(std::move(row)); }
    bool isEmpty() const { return _rows.empty(); }
    /// Empty without rows. A column that says "–" all the way down is left out.
    std::string text() const;

private:
    bool isSilent(std::size_t column) const;

    std::string _caption;
    std::vector<Column> _columns;
    std::vector<std::vector<TableCell>> _rows;
};

}  // namespace kelvo::report
