#pragma once

#include <cstddef>
#include <map>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

#include "platform/PropertyList.h"
#include "platform/Value.h"

namespace kelvo {

class KelvoModelNode;
using NodeRef = std::shared_ptr<const KelvoModelNode>;
using NodesByPath = std::map<std::string, NodeRef>;  // ordered: no keys of a modem's make it slow

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

    /// Builds the tree of a display object: root "Kelvo" at "/". Every node is stored in `nodesByPath` under its path;
    /// of two nodes with one path the later stays, and a parent is stored after its children. A dictionary or an array
    /// nested deeper than `kMaxDepth` is shown as "(unknown)", so that no tree can exhaust the stack; so is everything,
    /// and without a path, once the paths take `kMaxPathBytes` together, so that none can exhaust the memory.
    static NodeRef makeTreeFromObject(const Value& object, NodesByPath& nodesByPath);

    /// How many dictionaries and arrays may stand inside one another; no property list that is read nests deeper.
    static constexpr int kMaxDepth = kMaxPropertyListDepth;
    static constexpr std::size_t kMaxPathBytes = std::size_t{32} << 20;

private:
    std::string _name;
};

/// `parent` extended by `name` as a path component: "/" and "A" give "/A", "/A" and "B" give "/A/B". No separator is
/// doubled where the two meet, and an empty name leaves the path as it is.
std::string pathByAppending(std::string_view parent, std::string_view name);

}  // namespace kelvo
