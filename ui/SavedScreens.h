#pragma once

#include <chrono>
#include <optional>
#include <string>

#include "model/ShownValues.h"
#include "model/SnapshotFile.h"

namespace kelvo {

/// The screens of a saved snapshot, as they stood at its last refresh, and what a window says of them. Nothing in it
/// changes any more. The file keeps texts alone, so no value has a number, a record or a chart; its few refreshes tell
/// what stood there before.
class SavedScreens final : public ShownValues {
public:
    explicit SavedScreens(const SnapshotFile& file);
    /// Of a file that cannot be shown: no screens, but the reason.
    static SavedScreens refused(std::string reason);

    /// The root of the display tree; none when there are no screens.
    const NodeRef& topLevelNodes() const { return _root; }
    /// What stands in place of rows while there is no tree.
    const std::string& whyEmpty() const { return _whyEmpty; }
    /// What stands beside the status: that the readings are older than the snapshot, and what the user has written.
    const std::string& note() const { return _note; }

    NodeRef shownNodeAtPath(const std::string& path) const override { return _nodesByPath.find(path); }
    std::optional<Technology> technology() const override { return _technology; }
    const Trends& trends() const override { return _trends; }
    Trends::Time trendTime() const override { return _shownAt.value_or(Trends::Time(0)); }
    std::optional<Provenance> provenance(const KelvoModelNode&) const override { return std::nullopt; }
    std::string savedText() const override { return _savedText; }

private:
    SavedScreens() = default;
    void noteHistory(const std::vector<SnapshotFile::Entry>& entries, std::size_t shown);
    void word(const SnapshotFile& file);

    NodeRef _root;
    NodesByPath _nodesByPath;
    std::optional<Technology> _technology;
    Trends _trends;
    std::optional<Trends::Time> _shownAt;  // since 1970, of the refresh that is shown
    std::string _whyEmpty;
    std::string _savedText;
    std::string _note;
};

}  // namespace kelvo
