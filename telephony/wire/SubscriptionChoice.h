#pragma once

#include <cstdint>
#include <optional>

namespace kelvo::wire {

/// Whose records are shown on a phone with several SIMs: of the chosen one, or of the first that sends. The choice
/// holds when the modem comes back. Records that name no subscription (unwrapped ones, 0 and -1) always pass.
class SubscriptionChoice {
public:
    explicit SubscriptionChoice(std::optional<std::int32_t> chosen) : _chosen(chosen) {}

    bool admits(std::int32_t subscription) {
        if (subscription <= 0) return true;
        if (!_chosen) _chosen = subscription;
        return *_chosen == subscription;
    }
    /// None: not settled yet.
    std::optional<std::int32_t> chosen() const { return _chosen; }

private:
    std::optional<std::int32_t> _chosen;
};

}  // namespace kelvo::wire
