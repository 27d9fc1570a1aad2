#pragma once

#include <deque>
#include <functional>
#include <memory>
#include <span>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

#include "platform/values/Value.h"
#include "tools/export/Series.h"

namespace kelvo {

/// Finds what a record has written to a display, under the paths of the screens; rows of a list by the cell, channel or
/// context that they are about, as trends have it. It keeps beside the display what does not change from record to
/// record, the paths, so that a record costs little more than a look at each value's number.
///
/// The series are its own. It remembers a bounded number of them: a stream that names ever new ones begins anew.
class WrittenValues {
public:
    using Wants = std::function<bool(const std::string& path)>;

    /// `wants` says which paths are told of; it is asked once for each.
    WrittenValues(Technology technology, Wants wants);
    ~WrittenValues();
    WrittenValues(const WrittenValues&) = delete;
    WrittenValues& operator=(const WrittenValues&) = delete;

    /// The texts in `display` that the record with this number has written, in the display's order. Borrowed until the
    /// display changes.
    std::span<const Written> by(std::uint64_t record, const Value& display);

    /// Whether it is time to call `forget`.
    bool isFull() const { return _nodeCount + _series.size() > kMost; }
    /// Forgets all series; nobody may hold one any more.
    void forget();

private:
    struct Node;
    struct Child;
    struct List;

    static constexpr std::size_t kMost = 100'000;

    void visit(Child& child, const Value& value);
    void visitDictionary(Node& node, const Dictionary& dictionary);
    void visitArray(Node& node, const Array& array);
    void note(Child& child, const Value& value);
    Series& seriesAt(const std::string& path);
    bool isWritten(const Value& value) const;
    Child& childAt(Node& node, const Dictionary* dictionary, std::size_t index, std::string_view key);
    Child& rowAt(Node& node, std::size_t index, const Value& row);
    bool identify(List& list, const Dictionary& row);
    std::unique_ptr<Node> nodeAt(std::string path);

    const Technology _technology;
    const Wants _wants;
    std::uint64_t _record = 0;
    const Value* _display = nullptr;  // during a walk
    int _depth = 0;
    std::vector<Written> _written;
    std::deque<Series> _series;
    std::unordered_map<std::string_view, Series*> _seriesByPath;
    std::size_t _nodeCount = 0;
    std::unique_ptr<Child> _root;
};

}  // namespace kelvo
