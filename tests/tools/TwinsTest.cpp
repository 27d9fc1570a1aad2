// Every capture in tests/captures has a twin, the JSON that decoding it must give. A new pair is a new case without
// code; "--rebless" writes the twins anew.
#include <gtest/gtest.h>

#include <algorithm>
#include <filesystem>
#include <iostream>

#include "tests/support/RunProgram.h"

namespace kelvo {
namespace {

namespace fs = std::filesystem;

bool rebless = false;

class Twin : public testing::Test {
public:
    explicit Twin(fs::path capture) : _capture(std::move(capture)) {}

    void TestBody() override {
        const test::Finished done = test::run(KELVOCTL, {"decode", "--json", _capture.string()});
        ASSERT_EQ(done.status, 0) << done.errors;
        EXPECT_EQ(done.errors, "");
        const fs::path twin = fs::path(_capture).replace_extension(".json");
        if (rebless) std::ofstream(twin, std::ios::binary) << done.output;
        if (done.output == test::contentsOf(twin)) return;
        const test::TemporaryDirectory directory;
        const std::string got = directory.write("got.json", bytesOf(done.output));
        FAIL() << test::run("/usr/bin/diff", {"-u", "-N", twin.string(), got}).output
               << "When the change is meant, twins_tests --rebless rewrites the twin.";
    }

private:
    fs::path _capture;
};

class NoTwins : public testing::Test {
    void TestBody() override { FAIL() << "there are no captures in " KELVO_TEST_CAPTURES; }
};

void registerTwins() {
    std::vector<fs::path> captures;
    for (const auto& file : fs::directory_iterator(KELVO_TEST_CAPTURES)) {
        if (file.path().extension() == ".pcap") captures.push_back(file.path());
    }
    std::sort(captures.begin(), captures.end());
    for (const fs::path& capture : captures) {
        std::string name = capture.stem().string();
        std::replace(name.begin(), name.end(), '-', '_');
        testing::RegisterTest("Twins", name.c_str(), nullptr, nullptr, __FILE__, __LINE__,
                              [capture]() -> testing::Test* { return new Twin(capture); });
    }
    if (captures.empty()) {
        testing::RegisterTest("Twins", "AreThere", nullptr, nullptr, __FILE__, __LINE__,
                              []() -> testing::Test* { return new NoTwins; });
    }
}

}  // namespace
}  // namespace kelvo

int main(int argc, char** argv) {
    testing::InitGoogleTest(&argc, argv);
    for (int i = 1; i < argc; ++i) {
        if (std::string_view(argv[i]) != "--rebless") {
            std::cerr << "usage: twins_tests [--rebless]\n";
            return 2;
        }
        kelvo::rebless = true;
    }
    kelvo::registerTwins();
    return RUN_ALL_TESTS();
}
