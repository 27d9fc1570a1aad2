#pragma once

#include "model/KelvoModelNode.h"

namespace kelvo {

/// A node with a value and no children: a row that shows a text.
class KelvoModelLeafNode final : public KelvoModelNode {
public:
    KelvoModelLeafNode(std::string name, std::string value);

    const std::string* value() const override { return &_string; }

private:
    std::string _string;
};

}  // namespace kelvo
