#pragma once

#include <optional>

#include "model/KelvoModelNode.h"

namespace kelvo {

/// A node with a value and no children: a row that shows a text.
class KelvoModelLeafNode final : public KelvoModelNode {
public:
    KelvoModelLeafNode(std::string name, std::string value);
    /// `value` is a string.
    KelvoModelLeafNode(std::string name, const Value& value);

    const std::string* value() const override { return &_string; }
    const Reading* reading() const override { return _reading ? &*_reading : nullptr; }
    std::uint64_t record() const override { return _record; }

private:
    std::string _string;
    std::optional<Reading> _reading;
    std::uint64_t _record = 0;
};

}  // namespace kelvo
