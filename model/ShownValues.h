#pragma once

#include <optional>
#include <string>

#include "model/KelvoModelNode.h"
#include "model/Provenance.h"
#include "model/Trends.h"
#include "platform/telephony/Technology.h"

namespace kelvo {

/// The values on the screens and all that is known of them: what the details of one value are made of.
/// Main queue only.
class ShownValues {
public:
    virtual ~ShownValues() = default;

    /// The node at `path` of the tree that the screens show; none when it has no such node, and while there is no tree.
    virtual NodeRef shownNodeAtPath(const std::string& path) const = 0;
    /// The family whose screens these are; none while nobody knows.
    virtual std::optional<Technology> technology() const = 0;
    /// How the values have gone, and when that is now.
    virtual const Trends& trends() const = 0;
    virtual Trends::Time trendTime() const = 0;
    /// Where a node's value comes from; none when no record has written it, or nobody knows.
    virtual std::optional<Provenance> provenance(const KelvoModelNode& node) const = 0;
    /// Of values that were saved, what tells so, and of when they are: "Snapshot of 2011-03-04 at 09:15:02". The time
    /// of their trends is then that since 1970. Empty for live ones.
    virtual std::string savedText() const { return {}; }
};

}  // namespace kelvo
