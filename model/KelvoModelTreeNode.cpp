#include "model/KelvoModelTreeNode.h"

namespace kelvo {

KelvoModelTreeNode::KelvoModelTreeNode(std::string name, Children children)
    : KelvoModelNode(std::move(name)), _childNodes(std::move(children)) {}

}  // namespace kelvo
