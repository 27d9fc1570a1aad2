#include "ui/SavedScreens.h"

#include <fmt/format.h>

#include <algorithm>
#include <array>
#include <ctime>
#include <vector>

#include "glossary/Glossary.h"
#include "platform/encodings/Utf8.h"
#include "platform/system/DateText.h"
#include "platform/system/Environment.h"

namespace kelvo {
namespace {

using namespace std::chrono_literals;
using Time = Trends::Time;

constexpr Time kWorthTelling = 10s;         // between the last refresh and the moment of saving
constexpr std::size_t kMostRefreshes = 5;   // that a snapshot keeps
constexpr std::size_t kEnoughValues = 200;  // to know a family by

std::optional<Time> timeOf(const std::optional<std::string>& date) {
    const auto told = date ? dateFromDescription(*date) : std::nullopt;
    return told ? std::optional<Time>(told->time_since_epoch()) : std::nullopt;
}

std::string dayAndTime(Time since1970) {
    const std::tm at = clock().local(Clock::TimePoint(since1970));
    std::array<char, 64> text{};
    const std::size_t length = std::strftime(text.data(), text.size(), "%Y-%m-%d at %H:%M:%S", &at);
    return {text.data(), length};
}

/// How many of the tree's first values each family's glossary knows.
class FamilyCounts {
public:
    explicit FamilyCounts(const KelvoModelNode& root) { visit(root, "/"); }

    std::optional<Technology> most() const {
        const auto most = std::ranges::max_element(_known);
        if (*most == 0) return std::nullopt;
        return kTechnologies[static_cast<std::size_t>(most - _known.begin())].technology;
    }

private:
    void visit(const KelvoModelNode& node, const std::string& path) {
        if (node.childNodes() == nullptr) return count(path);
        for (const NodeRef& child : *node.childNodes()) {
            if (_values >= kEnoughValues) return;
            visit(*child, pathByAppending(path, child->displayName()));
        }
    }
    void count(const std::string& path) {
        ++_values;
        for (std::size_t i = 0; i < kTechnologies.size(); ++i) {
            if (meaningAt(kTechnologies[i].technology, path) != nullptr) ++_known[i];
        }
    }

    std::size_t _values = 0;
    std::array<std::size_t, kTechnologies.size()> _known{};  // in the order of the families
};

}  // namespace

SavedScreens::SavedScreens(const SnapshotFile& file) : _whyEmpty("This snapshot holds no readings") {
    const auto& entries = file.entries;
    const auto last =
        std::find_if(entries.rbegin(), entries.rend(), [](const auto& each) { return bool(each.display); });
    if (last != entries.rend()) {
        _root = KelvoModelNode::makeTreeFromObject(last->display, _nodesByPath);
        _technology = FamilyCounts(*_root).most();
        noteHistory(entries, static_cast<std::size_t>(entries.rend() - last) - 1);
    }
    word(file);
}

SavedScreens SavedScreens::refused(std::string reason) {
    SavedScreens none;
    none._whyEmpty = std::move(reason);
    none._savedText = "Nothing to show";
    return none;
}

/// The refreshes up to the one shown, as far as they tell their times and these go forward.
void SavedScreens::noteHistory(const std::vector<SnapshotFile::Entry>& entries, std::size_t shown) {
    _shownAt = timeOf(entries[shown].date);
    if (!_shownAt) return;
    std::vector<std::pair<Time, const Value*>> refreshes = {{*_shownAt, &entries[shown].display}};
    for (std::size_t i = shown; i-- > 0 && refreshes.size() < kMostRefreshes;) {
        const auto at = timeOf(entries[i].date);
        if (at && *at < refreshes.back().first && entries[i].display) refreshes.emplace_back(*at, &entries[i].display);
    }
    for (auto refresh = refreshes.rbegin(); refresh != refreshes.rend(); ++refresh)
        _trends.note(*refresh->second, refresh->first);
}

void SavedScreens::word(const SnapshotFile& file) {
    const auto savedAt = timeOf(file.timestamp);
    const auto told = savedAt ? savedAt : _shownAt;
    _savedText = told ? "Snapshot of " + dayAndTime(*told) : "Snapshot of an unknown time";
    const bool isOlder = savedAt && _shownAt && *savedAt - *_shownAt >= kWorthTelling;
    if (isOlder) _note = "Readings of " + dayAndTime(*_shownAt);
    const std::string words = printable(file.description.value_or(""));
    if (!words.empty()) _note += (isOlder ? ": " : "") + words;
}

}  // namespace kelvo
