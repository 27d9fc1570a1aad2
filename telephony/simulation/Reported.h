#pragma once

#include <optional>

#include "telephony/simulation/Time.h"

namespace kelvo::simulation {

/// What a record told last: it is due again when that has changed, and when it has stood for a while.
template <class Content>
class Reported {
public:
    /// True when the record is to be written now, which it then counts as; without a period, only for a change.
    bool isDue(Time now, const Content& content, Time period = Time::max()) {
        if (_last && *_last == content && now - _at < period) return false;
        _last = content;
        _at = now;
        return true;
    }

private:
    std::optional<Content> _last;
    Time _at{0};
};

}  // namespace kelvo::simulation
