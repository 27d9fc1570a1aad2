#include "model/KelvoModelLeafNode.h"

namespace kelvo {

KelvoModelLeafNode::KelvoModelLeafNode(std::string name, std::string value)
    : KelvoModelNode(std::move(name)), _string(std::move(value)) {}

KelvoModelLeafNode::KelvoModelLeafNode(std::string name, const Value& value)
    : KelvoModelNode(std::move(name)), _string(*value.string()), _record(value.record()) {
    if (const Reading* reading = value.reading()) _reading = *reading;
}

}  // namespace kelvo
