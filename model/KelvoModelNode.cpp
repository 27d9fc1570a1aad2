#include "model/KelvoModelNode.h"

#include <algorithm>
#include <optional>

#include "LogGenerator/ArrayLock.h"
#include "model/DisplayPath.h"
#include "model/KelvoModelLeafNode.h"
#include "model/KelvoModelTreeNode.h"

namespace kelvo {

namespace {

/// One walk over a display object.
class TreeBuilder {
public:
    NodeRef build(std::string name, const Value& object) {
        if (object.string() != nullptr) return std::make_shared<KelvoModelLeafNode>(std::move(name), object);
        const bool inner = object.dictionary() || object.array();
        if (!inner || _depth == KelvoModelNode::kMaxDepth) {
            return std::make_shared<KelvoModelLeafNode>(std::move(name), std::string("(unknown)"));
        }
        ++_depth;
        auto children = object.array() ? childrenOf(*object.array()) : childrenOf(*object.dictionary());
        --_depth;
        return std::make_shared<KelvoModelTreeNode>(std::move(name), std::move(children));
    }

private:
    KelvoModelNode::Children childrenOf(const Dictionary& dictionary) {
        KelvoModelNode::Children children;
        children.reserve(dictionary.size());
        if (dictionary.find("_sorted") == nullptr) {
            for (const Dictionary::Entry& entry : dictionary) appendEntry(children, entry.key, entry);
            return children;
        }
        std::vector<const Dictionary::Entry*> entries;
        entries.reserve(dictionary.size());
        for (const Dictionary::Entry& entry : dictionary) entries.push_back(&entry);
        std::sort(entries.begin(), entries.end(), [](const auto* a, const auto* b) { return a->key < b->key; });
        for (const auto* entry : entries) appendEntry(children, nameOfSortedKey(entry->key), *entry);
        return children;
    }

    void appendEntry(KelvoModelNode::Children& children, std::string_view name, const Dictionary::Entry& entry) {
        if (entry.key != "_sorted" && entry.value) children.push_back(build(std::string(name), entry.value));
    }

    KelvoModelNode::Children childrenOf(const Array& array) {
        KelvoModelNode::Children children;
        // The outermost array takes the lock for all: it counts its depth in 8 bits, and a display can nest deeper.
        std::optional<ArrayLock::Held> lock;
        if (_openArrays++ == 0) lock.emplace();
        children.reserve(array.size());
        for (const Value& element : array) children.push_back(build(std::to_string(children.size()), element));
        --_openArrays;
        return children;
    }

    int _depth = 0;
    int _openArrays = 0;
};

/// The last node at `wanted`, in the order in which nodes are finished, of those from `node` down, which is at `path`.
const NodeRef* findLast(const NodeRef& node, std::string& path, std::string_view wanted) {
    static const KelvoModelNode::Children kNone;
    if (!wanted.starts_with(path)) return nullptr;  // paths grow on their way down
    if (path == wanted) return &node;
    const KelvoModelNode::Children& children = node->childNodes() != nullptr ? *node->childNodes() : kNone;
    const std::size_t length = path.size();
    for (auto child = children.rbegin(); child != children.rend(); ++child) {
        appendToPath(path, (*child)->displayName());
        const NodeRef* found = findLast(*child, path, wanted);
        path.resize(length);
        if (found != nullptr) return found;
    }
    return nullptr;
}

}  // namespace

NodeRef NodesByPath::find(std::string_view path) const {
    std::string at = "/";
    const NodeRef* found = _root ? findLast(_root, at, path) : nullptr;
    return found != nullptr ? *found : nullptr;
}

NodeRef KelvoModelNode::makeTreeFromObject(const Value& object, NodesByPath& nodesByPath) {
    nodesByPath._root = TreeBuilder().build("Kelvo", object);
    return nodesByPath._root;
}

}  // namespace kelvo
