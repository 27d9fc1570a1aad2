#include "tools/DisplayText.h"

#include <algorithm>

namespace kelvo {

namespace {

constexpr std::size_t kWidestColumn = 40;  // one long name does not push its siblings' values away

std::size_t width(std::string_view cleanText) {
    return static_cast<std::size_t>(
        std::count_if(cleanText.begin(), cleanText.end(), [](char c) { return (c & 0xc0) != 0x80; }));
}

std::string leafLine(std::string line, std::string_view value, std::size_t nameColumns) {
    if (value.empty()) return line;
    const std::size_t columns = width(line);
    line.append(columns < nameColumns ? nameColumns - columns : 0, ' ');
    return line.append("  ").append(printable(value));
}

void appendChildren(std::vector<DisplayLine>& lines, const KelvoModelNode::Children& children, std::size_t indent) {
    std::size_t nameColumns = 0;
    std::vector<std::string> names;
    names.reserve(children.size());
    for (const NodeRef& child : children) {
        names.push_back(std::string(indent, ' ') + printable(child->displayName()));
        if (child->value() != nullptr) nameColumns = std::max(nameColumns, width(names.back()));
    }
    nameColumns = std::min(nameColumns, indent + kWidestColumn);
    for (std::size_t i = 0; i < children.size(); ++i) {
        const KelvoModelNode& child = *children[i];
        if (child.value() != nullptr) {
            lines.push_back({leafLine(std::move(names[i]), *child.value(), nameColumns), &child});
        } else {
            lines.push_back({std::move(names[i]), &child});
            appendChildren(lines, *child.childNodes(), indent + 2);
        }
    }
}

}  // namespace

std::vector<DisplayLine> displayLines(const KelvoModelNode& root) {
    if (root.value() != nullptr) return {{leafLine(printable(root.displayName()), *root.value(), 0), &root}};
    std::vector<DisplayLine> lines;
    appendChildren(lines, *root.childNodes(), 0);
    return lines;
}

std::string displayText(const Value& display) {
    NodesByPath nodesByPath;
    std::string text;
    const NodeRef root = KelvoModelNode::makeTreeFromObject(display, nodesByPath);
    for (const DisplayLine& line : displayLines(*root)) text.append(line.text).append("\n");
    return text;
}

}  // namespace kelvo
