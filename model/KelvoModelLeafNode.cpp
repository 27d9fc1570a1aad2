#include "model/KelvoModelLeafNode.h"

namespace kelvo {

KelvoModelLeafNode::KelvoModelLeafNode(std::string name, std::string value)
    : KelvoModelNode(std::move(name)), _string(std::move(value)) {}

}  // namespace kelvo
