#include "model/KelvoModelNode.h"

#include <algorithm>
#include <optional>

#include "LogGenerator/ArrayLock.h"
#include "model/KelvoModelLeafNode.h"
#include "model/KelvoModelTreeNode.h"

namespace kelvo {

namespace {

void appendToPath(std::string& path, std::string_view name) {
    name.remove_prefix(std::min(name.find_first_not_of('/'), name.size()));
    if (name.empty()) return;
    if (!path.ends_with('/')) path += '/';
    path += name;
}

/// "02;RSCP" is shown as "RSCP" and ordered by its prefix; a key with no or with several ";" is its own name.
std::string_view nameOfSortedKey(std::string_view key) {
    const std::size_t separator = key.find(';');
    const bool twoParts = separator != key.npos && key.find(';', separator + 1) == key.npos;
    return twoParts ? key.substr(separator + 1) : key;
}

/// One walk over a display object. The path of the node being built is one buffer that grows and shrinks on the way.
class TreeBuilder {
public:
    explicit TreeBuilder(NodesByPath& nodesByPath) : _nodesByPath(nodesByPath) {}

    NodeRef build(std::string_view name, const Value& object) {
        if (_path.size() > _pathBytesLeft) return makeNode(std::string(name), Value());
        _pathBytesLeft -= _path.size();
        NodeRef node = makeNode(std::string(name), object);
        _nodesByPath.insert_or_assign(_path, node);
        return node;
    }

private:
    NodeRef makeNode(std::string name, const Value& object) {
        if (const std::string* text = object.string()) {
            return std::make_shared<KelvoModelLeafNode>(std::move(name), *text);
        }
        const bool inner = object.dictionary() || object.array();
        if (!inner || _depth == KelvoModelNode::kMaxDepth) {
            return std::make_shared<KelvoModelLeafNode>(std::move(name), "(unknown)");
        }
        ++_depth;
        auto children = object.array() ? childrenOf(*object.array()) : childrenOf(*object.dictionary());
        --_depth;
        return std::make_shared<KelvoModelTreeNode>(std::move(name), std::move(children));
    }

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
        if (entry.key != "_sorted" && entry.value) children.push_back(buildChild(name, entry.value));
    }

    KelvoModelNode::Children childrenOf(const Array& array) {
        KelvoModelNode::Children children;
        // The outermost array takes the lock for all: it counts its depth in 8 bits, and a display can nest deeper.
        std::optional<ArrayLock::Held> lock;
        if (_openArrays++ == 0) lock.emplace();
        children.reserve(array.size());
        for (const Value& element : array) children.push_back(buildChild(std::to_string(children.size()), element));
        --_openArrays;
        return children;
    }

    NodeRef buildChild(std::string_view name, const Value& object) {
        const std::size_t parentLength = _path.size();
        appendToPath(_path, name);
        NodeRef child = build(name, object);
        _path.resize(parentLength);
        return child;
    }

    NodesByPath& _nodesByPath;
    std::string _path = "/";
    std::size_t _pathBytesLeft = KelvoModelNode::kMaxPathBytes;
    int _depth = 0;
    int _openArrays = 0;
};

}  // namespace

NodeRef KelvoModelNode::makeTreeFromObject(const Value& object, NodesByPath& nodesByPath) {
    return TreeBuilder(nodesByPath).build("Kelvo", object);
}

std::string pathByAppending(std::string_view parent, std::string_view name) {
    std::string path(parent);
    appendToPath(path, name);
    return path;
}

}  // namespace kelvo
