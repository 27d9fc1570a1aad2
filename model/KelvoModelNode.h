#pragma once

#include <cstdint>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "model/DisplayPath.h"
#include "platform/encodings/PropertyList.h"
#include "platform/values/Value.h"

namespace kelvo {

class KelvoModelNode;
using NodeRef = std::shared_ptr<const KelvoModelNode>;

/// The nodes of a tree by their paths. Paths are made when one is looked for: a screen looks for its own alone, and the
/// tree is built anew every two seconds.
class NodesByPath {
public:
    /// The node at `path`; null when there is none.
    NodeRef find(std::string_view path) const;
    void clear() { _root.reset(); }

private:
    friend class KelvoModelNode;

    NodeRef _root;
};

/// One named node of the display tree. Immutable once built; panes hold on to nodes of an older tree while they need
/// them.
class KelvoModelNode {
public:
    using Children = std::vector<NodeRef>;

    explicit KelvoModelNode(std::string name) : _name(std::move(name)) {}
    virtual ~KelvoModelNode() = default;
    KelvoModelNode(const KelvoModelNode&) = delete;
    KelvoModelNode& operator=(const KelvoModelNode&) = delete;

    const std::string& displayName() const { return _name; }
    /// The children in their order; null for a leaf.
    virtual const Children* childNodes() const { return nullptr; }
    /// The value shown; null for an inner node.
    virtual const std::string* value() const { return nullptr; }
    /// What the record reported whose text the value is; null when no record's number stands behind it.
    virtual const Reading* reading() const { return nullptr; }
    /// The number of the record that wrote the value last; 0 when none has. `KelvoModel::provenance` knows more of it.
    virtual std::uint64_t record() const { return 0; }
    /// The value's number in its unit; none for texts.
    std::optional<Measurement> measurement() const {
        return reading() != nullptr ? reading()->quantity->measure(reading()->raw) : std::nullopt;
    }

    /// Builds the tree of a display object: root "Kelvo" at "/". Every node is found in `nodesByPath`, which forgets
    /// other trees, under its path; of two nodes with one path the later is found, and a parent is later than its
    /// children. A dictionary or an array nested deeper than `kMaxDepth` is shown as "(unknown)", so that no tree can
    /// exhaust the stack.
    static NodeRef makeTreeFromObject(const Value& object, NodesByPath& nodesByPath);

    /// How many dictionaries and arrays may stand inside one another; no property list that is read nests deeper.
    static constexpr int kMaxDepth = kMaxPropertyListDepth;

private:
    std::string _name;
};

}  // namespace kelvo
