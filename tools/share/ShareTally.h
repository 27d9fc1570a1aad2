#pragma once

#include <cstdint>
#include <map>
#include <string>
#include <string_view>

#include "tools/share/Identity.h"

namespace kelvo {

/// What was replaced, field by field, and what was removed and why.
class ShareTally {
public:
    struct Replaced {
        Identity identity{};
        std::uint64_t values = 0;
    };

    void replaced(std::string_view field, Identity identity) {
        auto found = _replaced.find(field);
        if (found == _replaced.end()) found = _replaced.emplace(field, Replaced{identity}).first;
        ++found->second.values;
    }
    /// `what` says of one thing what it is and why it goes; several are counted.
    void removed(std::string_view what, std::uint64_t count = 1) {
        if (count == 0) return;
        auto found = _removed.find(what);
        // A file may be made of nothing but kinds.
        if (found == _removed.end() && _removed.size() >= kMostKinds)
            found = _removed.try_emplace("other things").first;
        if (found == _removed.end()) found = _removed.try_emplace(std::string(what)).first;
        found->second += count;
    }

    const std::map<std::string, Replaced, std::less<>>& replaced() const { return _replaced; }
    const std::map<std::string, std::uint64_t, std::less<>>& removed() const { return _removed; }

private:
    static constexpr std::size_t kMostKinds = 200;
    std::map<std::string, Replaced, std::less<>> _replaced;
    std::map<std::string, std::uint64_t, std::less<>> _removed;
};

}  // namespace kelvo
