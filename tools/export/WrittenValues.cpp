#include "tools/export/WrittenValues.h"

#include <algorithm>
#include <array>
#include <cstring>

#include "model/CellIdentity.h"
#include "model/DisplayPath.h"
#include "model/KelvoModelNode.h"

namespace kelvo {

namespace {

constexpr std::string_view kSorted = "_sorted";
constexpr std::size_t kMostStrangers = 64;  // children that a container no longer has

}  // namespace

/// What stands under one key, or one row.
struct WrittenValues::Child {
    std::string key;
    std::string path;
    bool isHidden = false;         // says in which order the others stand
    Series* series = nullptr;      // of a text; none until one was written
    std::unique_ptr<Node> node{};  // of a dictionary or an array; none until there was one
};

/// What helps to tell the rows of a list apart.
struct WrittenValues::List {
    struct Entry {
        std::string key;
        bool names = false;  // a part of the row's identity
    };
    std::vector<Entry> layout{};                    // of the row that was looked at last: rows are alike
    std::string channel{};                          // that all of them are on, during a walk
    std::string identity{};                         // raw, of the row in hand
    std::unordered_map<std::string, Child> rows{};  // by that
};

/// A dictionary or an array.
struct WrittenValues::Node {
    std::string path;
    std::vector<Child> children{};  // in the order of the entries when they were met last
    std::unique_ptr<List> list{};   // of an array
};

WrittenValues::WrittenValues(Technology technology, Wants wants)
    : _technology(technology),
      _wants(std::move(wants)),
      _root(std::make_unique<Child>(Child{.key = {}, .path = "/"})) {}

WrittenValues::~WrittenValues() = default;

void WrittenValues::forget() {
    _root = std::make_unique<Child>(Child{.key = {}, .path = "/"});
    _written.clear();
    _seriesByPath.clear();
    _series.clear();
    _nodeCount = 0;
}

std::span<const Written> WrittenValues::by(std::uint64_t record, const Value& display) {
    _record = record;
    _display = &display;
    _written.clear();
    visit(*_root, display);
    return _written;
}

void WrittenValues::visit(Child& child, const Value& value) {
    const bool isInner = value.dictionary() || value.array();
    if (!isInner) {
        if (value.record() == _record && value.string() != nullptr) note(child, value);
        return;
    }
    if (_depth == KelvoModelNode::kMaxDepth) return;
    if (!child.node) child.node = nodeAt(child.path);
    ++_depth;
    value.array() ? visitArray(*child.node, *value.array()) : visitDictionary(*child.node, *value.dictionary());
    --_depth;
}

void WrittenValues::visitDictionary(Node& node, const Dictionary& dictionary) {
    std::size_t index = 0;
    for (const auto& [key, value] : dictionary) {
        const std::size_t at = index++;
        const bool isInner = value.kind() >= Value::Kind::Array;
        if (!isInner && value.record() != _record) continue;  // most of them
        Child& child = childAt(node, &dictionary, at, key);
        if (!child.isHidden) visit(child, value);
    }
}

void WrittenValues::visitArray(Node& node, const Array& array) {
    if (!node.list) node.list = std::make_unique<List>();
    bool isChannelKnown = false;
    for (std::size_t index = 0; index < array.size(); ++index) {
        const Value& row = array[index];
        if (!isWritten(row)) continue;
        if (!isChannelKnown) node.list->channel = channelOfList(*_display, node.path);
        isChannelKnown = true;
        visit(rowAt(node, index, row), row);
    }
}

/// Whether the record has written anything in a row.
bool WrittenValues::isWritten(const Value& value) const {
    if (value.array()) return std::ranges::any_of(*value.array(), [this](const Value& v) { return isWritten(v); });
    if (!value.dictionary()) return value.record() == _record;
    return std::ranges::any_of(*value.dictionary(), [this](const auto& entry) {
        return entry.value.kind() < Value::Kind::Array ? entry.value.record() == _record : isWritten(entry.value);
    });
}

void WrittenValues::note(Child& child, const Value& value) {
    if (child.series == nullptr) child.series = &seriesAt(child.path);
    if (child.series->isWanted) _written.push_back({child.series, &value});
}

/// Two rows may have the same name, and so the same series.
Series& WrittenValues::seriesAt(const std::string& path) {
    const auto known = _seriesByPath.find(path);
    if (known != _seriesByPath.end()) return *known->second;
    Series& series = _series.emplace_back(Series{.technology = _technology, .path = path, .isWanted = _wants(path)});
    _seriesByPath.emplace(series.path, &series);
    return series;
}

/// The child for the entry at `index`. Entries keep their places, so it is nearly always the one that was there.
WrittenValues::Child& WrittenValues::childAt(Node& node, const Dictionary* dictionary, std::size_t index,
                                             std::string_view key) {
    auto& children = node.children;
    if (index < children.size() && isSameText(children[index].key, key)) return children[index];
    auto known = std::ranges::find(children, key, &Child::key);
    if (known == children.end()) {
        if (children.size() > index + kMostStrangers) children.resize(index);
        const bool isSorted = dictionary != nullptr && dictionary->find(kSorted) != nullptr;
        Child child{.key = std::string(key), .path = pathByAppending(node.path, isSorted ? nameOfSortedKey(key) : key)};
        child.isHidden = key == kSorted;
        ++_nodeCount;
        known = children.insert(children.end(), std::move(child));
    }
    const auto place = children.begin() + static_cast<std::ptrdiff_t>(std::min(index, children.size() - 1));
    std::iter_swap(place, known);
    return *place;
}

/// The child for a row: that of its subject, wherever it stands, or else that of its place.
WrittenValues::Child& WrittenValues::rowAt(Node& node, std::size_t index, const Value& row) {
    List& list = *node.list;
    if (!row.dictionary() || !identify(list, *row.dictionary())) {
        return childAt(node, nullptr, index, std::to_string(index));
    }
    const auto known = list.rows.find(list.identity);
    if (known != list.rows.end()) return known->second;
    std::string identity = identityOf(*row.dictionary());
    if (!list.channel.empty()) identity += ", " + list.channel;
    ++_nodeCount;
    Child child{.key = {}, .path = pathByAppending(node.path, identity)};
    return list.rows.emplace(list.identity, std::move(child)).first->second;
}

/// Puts what names the row's subject into the list's `identity`, without printing it; false when nothing names it.
bool WrittenValues::identify(List& list, const Dictionary& row) {
    std::size_t index = 0;
    bool isNamed = false;
    list.identity.assign(list.channel);
    for (const auto& [key, value] : row) {
        if (index == list.layout.size()) list.layout.emplace_back();
        List::Entry& entry = list.layout[index++];
        if (!isSameText(entry.key, key)) entry = {key, shortNameOf(nameOfSortedKey(key)) != nullptr};
        if (!entry.names) continue;
        if (const Reading* reading = value.reading()) {
            std::array<char, sizeof reading->raw + sizeof reading->quantity> raw{};
            std::memcpy(raw.data(), &reading->raw, sizeof reading->raw);
            std::memcpy(raw.data() + sizeof reading->raw, &reading->quantity, sizeof reading->quantity);
            list.identity.append(raw.data(), raw.size());
        } else if (const std::string* text = value.string()) {
            list.identity.append(*text).push_back('\0');
        } else {
            continue;
        }
        isNamed = true;
    }
    return isNamed;
}

std::unique_ptr<WrittenValues::Node> WrittenValues::nodeAt(std::string path) {
    ++_nodeCount;
    return std::make_unique<Node>(Node{.path = std::move(path)});
}

}  // namespace kelvo
