#include "platform/system/Lifetime.h"

#include <gtest/gtest.h>

#include <functional>
#include <optional>
#include <string>
#include <vector>

namespace kelvo {
namespace {

struct Owner {
    explicit Owner(std::vector<std::string>* to) : heard(to) {}
    std::function<void(int, const std::string&)> callback() {
        return lifetime.whileAlive(
            [this](int number, const std::string& text) { heard->push_back(text + std::to_string(number)); });
    }

    std::vector<std::string>* heard;
    Lifetime lifetime{};
};

TEST(Lifetime, LetsCallsThroughWhileTheOwnerIsThere) {
    std::vector<std::string> heard;
    Owner owner{&heard};
    const auto call = owner.callback();
    call(1, "a");
    call(2, "b");
    EXPECT_EQ(heard, (std::vector<std::string>{"a1", "b2"}));
}

TEST(Lifetime, LetsNoCallThroughOnceTheOwnerHasGone) {
    std::vector<std::string> heard;
    std::optional<Owner> owner(std::in_place, &heard);
    const auto call = owner->callback();
    owner.reset();
    call(1, "a");
    EXPECT_TRUE(heard.empty());
}

TEST(Lifetime, HandsOnWhatOnlyMoves) {
    const Lifetime lifetime;
    int got = 0;
    const auto call = lifetime.whileAlive([&got](std::unique_ptr<int> number) { got = *number; });
    call(std::make_unique<int>(7));
    EXPECT_EQ(got, 7);
}

// A callback may end its own owner: nothing of the token is touched after that.
TEST(Lifetime, MayEndInsideACallback) {
    std::optional<Lifetime> lifetime(std::in_place);
    int calls = 0;
    const auto call = lifetime->whileAlive([&] {
        ++calls;
        lifetime.reset();
    });
    call();
    call();
    EXPECT_EQ(calls, 1);
}

}  // namespace
}  // namespace kelvo
