#pragma once

#include <unordered_map>
#include <vector>

#include "LogGenerator/LogCode.h"

namespace kelvo {

class Base;

/// Log code to the sections that subscribe to it, in the order in which they did.
class CodeDictionary {
public:
    using Subscribers = std::vector<Base*>;

    /// A section that subscribes twice receives each packet twice.
    void subscribe(LogCode code, Base& section);
    /// Null when nobody subscribed.
    const Subscribers* find(LogCode code) const;
    /// The codes, in the order of their first subscription.
    const std::vector<LogCode>& allCodes() const { return _order; }

private:
    std::unordered_map<LogCode, Subscribers> _subscribers;
    std::vector<LogCode> _order;
};

}  // namespace kelvo
