#include "platform/system/Environment.h"

#include <gtest/gtest.h>

#include "tests/support/CapturedOutput.h"
#include "tests/support/RecordingLog.h"

namespace kelvo {
namespace {

using Lines = std::vector<test::RecordingLog::Line>;

TEST(LogLine, NeverTakesATextForAFormat) {
    test::RecordingLog log;
    const Environment::Scope environment({.log = &log});
    const std::string hostile = "%n%s%1000000d {} %";
    logLine(Level::Error, hostile);
    logLine(Level::Warning, "said: %s", hostile);
    EXPECT_EQ(log.lines(), (Lines{{3, hostile}, {4, "said: " + hostile}}));
}

TEST(Environment, IsBackAsItWasAfterwards) {
    EXPECT_FALSE(logWants(Level::Error));
    test::RecordingLog log;
    {
        const Environment::Scope environment({.log = &log, .version = "2"});
        EXPECT_TRUE(logWants(Level::Error));
        EXPECT_EQ(Environment::current().version, "2");
    }
    logLine(Level::Error, "to nobody");
    printLine("to nobody");
    EXPECT_TRUE(log.lines().empty());
    EXPECT_EQ(Environment::current().version, "");
}

TEST(Environment, PrintsLinesWhereItIsTold) {
    const test::CapturedOutput output;
    {
        const Environment::Scope environment({.standardOutput = output.file()});
        printLine("Deallocing {} %s");
    }
    EXPECT_EQ(output.text(), "Deallocing {} %s\n");
}

}  // namespace
}  // namespace kelvo
