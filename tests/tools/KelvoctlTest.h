#pragma once

#include <gtest/gtest.h>

#include <nlohmann/json.hpp>

#include "tests/support/CaptureFile.h"
#include "tests/support/Record.h"
#include "tests/support/RunProgram.h"

namespace kelvo::test {

/// Runs the program itself on files of a directory of its own.
struct KelvoctlTest : testing::Test {
    Finished kelvoctl(std::vector<std::string> arguments, const std::string& input = "/dev/null") {
        return run(KELVOCTL, std::move(arguments), input);
    }

    /// Writes a capture of these messages, a second apart, and says where it lies.
    std::string capture(Technology technology, const std::vector<Bytes>& messages) {
        CaptureWriter writer = captureAt(path("in.pcap"), technology);
        for (std::size_t i = 0; i < messages.size(); ++i) {
            EXPECT_TRUE(writer.append(CaptureTime(std::chrono::seconds(i)), messages[i]));
        }
        return path("in.pcap");
    }
    std::string path(const std::string& name) { return directory.file(name); }
    /// The program's answer as JSON; null, and a failure, when it is none.
    nlohmann::ordered_json json(std::vector<std::string> arguments) {
        const Finished done = kelvoctl(std::move(arguments));
        EXPECT_EQ(done.status, 0) << done.errors;
        auto json = nlohmann::ordered_json::parse(done.output, nullptr, false);
        EXPECT_FALSE(json.is_discarded()) << done.output;
        return json;
    }

    TemporaryDirectory directory;
};

/// An LTE serving cell: 10 MHz down, 5 MHz up.
inline Bytes servingCell(std::uint16_t physicalCellId) {
    return Record(0xB0C2, 38)
        .u16(14, physicalCellId)
        .u16(16, 5780)
        .u16(18, 23780)
        .u8(20, 50)
        .u8(21, 25)
        .u32(22, 77)
        .u16(26, 4566)
        .u32(28, 17)
        .bytes();
}

inline void expectFailure(const Finished& done, const std::string& line) {
    EXPECT_EQ(done.status, 1);
    EXPECT_EQ(done.errors, "kelvoctl: " + line + "\n");
    EXPECT_EQ(done.output, "");
}

}  // namespace kelvo::test
