#include "platform/system/Environment.h"

#include <gtest/gtest.h>

#include <cstdlib>

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
    char* text = nullptr;
    std::size_t size = 0;
    std::FILE* output = ::open_memstream(&text, &size);
    {
        const Environment::Scope environment({.standardOutput = output});
        printLine("Deallocing {} %s");
    }
    std::fclose(output);
    EXPECT_STREQ(text, "Deallocing {} %s\n");
    std::free(text);
}

}  // namespace
}  // namespace kelvo
