#pragma once

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

#include "model/KelvoModelNode.h"
#include "platform/encodings/Utf8.h"

namespace kelvo {

/// One line of the display tree and the node that it shows.
struct DisplayLine {
    std::string text;
    const KelvoModelNode* node;  ///< the tree's
};

/// The display tree as lines without their line ends: a node's children in their order, two blanks deeper than the
/// node; among siblings the values start in one column. The root shows as itself only when it is a leaf.
std::vector<DisplayLine> displayLines(const KelvoModelNode& root);

/// The same as one text. A display of none shows as on the screens.
std::string displayText(const Value& display);

}  // namespace kelvo
