#include "tools/report/HtmlTable.h"

#include <fmt/format.h>

#include <algorithm>

#include "tools/report/Words.h"

namespace kelvo::report {

bool HtmlTable::isSilent(std::size_t column) const {
    return column != 0 && std::ranges::all_of(_rows, [&](const auto& row) { return row[column].text == "–"; });
}

std::string HtmlTable::text() const {
    if (_rows.empty()) return {};
    // A region that scrolls can be reached by keys.
    std::string out = fmt::format(
        "<div class=\"scroll\" tabindex=\"0\" role=\"region\" aria-label=\"{0}\"><table class=\"sortable\">"
        "<caption>{0}</caption>\n<thead><tr>",
        html(_caption));
    std::vector<std::size_t> told;
    for (std::size_t i = 0; i < _columns.size(); ++i) {
        if (!isSilent(i)) told.push_back(i);
    }
    const auto kindOf = [&](std::size_t i) { return _columns[i].kind == Kind::Number ? " class=\"n\"" : ""; };
    for (const std::size_t i : told) {
        out += fmt::format("<th scope=\"col\"{}>{}</th>", kindOf(i), html(_columns[i].title));
    }
    out += "</tr></thead>\n<tbody>\n";
    for (const auto& row : _rows) {
        out += "<tr>";
        for (const std::size_t i : told) {
            const TableCell& cell = row[i];
            const std::string key = cell.key.empty() ? std::string() : fmt::format(" data-k=\"{}\"", html(cell.key));
            out += i == 0 ? fmt::format("<th scope=\"row\"{}{}>{}</th>", kindOf(i), key, html(cell.text))
                          : fmt::format("<td{}{}>{}</td>", kindOf(i), key, html(cell.text));
        }
        out += "</tr>\n";
    }
    return out + "</tbody></table></div>\n";
}

}  // namespace kelvo::report
