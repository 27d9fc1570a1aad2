#pragma once

#include <memory>
#include <utility>

namespace kelvo {

/// The lifetime of the object that has this as a member: whatever others keep to call the object later (a task on the
/// queue, a timer's, a port's callback) goes through `whileAlive` and does nothing once the object has gone.
/// Declared last, so that it ends before the members that a callback uses. Main queue only: it tells that the object is
/// there when the call begins, and keeps nothing alive.
class Lifetime {
public:
    Lifetime() = default;
    Lifetime(const Lifetime&) = delete;
    Lifetime& operator=(const Lifetime&) = delete;

    /// `work`, which returns nothing, as a callback that may be kept for as long as one likes.
    template <class Work>
    auto whileAlive(Work work) const {
        return [token = std::weak_ptr(_token), work = std::move(work)](auto&&... arguments) {
            if (!token.expired()) work(std::forward<decltype(arguments)>(arguments)...);
        };
    }

private:
    const std::shared_ptr<const bool> _token = std::make_shared<const bool>(true);
};

}  // namespace kelvo
