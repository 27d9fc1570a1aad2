#pragma once

#include "model/KelvoModelNode.h"

namespace kelvo {

/// A node with children and no value: a row that opens a screen of its own.
class KelvoModelTreeNode final : public KelvoModelNode {
public:
    KelvoModelTreeNode(std::string name, Children children);

    const Children* childNodes() const override { return &_childNodes; }

private:
    Children _childNodes;
};

}  // namespace kelvo
