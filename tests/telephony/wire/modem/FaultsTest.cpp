#include "telephony/wire/modem/Faults.h"

#include <gtest/gtest.h>

namespace kelvo::modem {
namespace {

TEST(Faults, AreReadFromAListOfNames) {
    const auto faults = Faults::parse("noise,hang-up");
    ASSERT_TRUE(faults);
    EXPECT_TRUE(faults->has(Fault::Noise));
    EXPECT_TRUE(faults->has(Fault::HangUp));
    EXPECT_FALSE(faults->has(Fault::Flood));
    EXPECT_TRUE(Faults::parse(""));
}

TEST(Faults, OfNoNameAreRefusedByTheirName) {
    const auto faults = Faults::parse("noise,nose");
    ASSERT_FALSE(faults);
    EXPECT_EQ(faults.error().reason, "no fault is called \"nose\"");
    EXPECT_FALSE(Faults::parse("noise,,flood"));
}

TEST(Faults, EachHaveANameOfTheirOwn) {
    for (const FaultEntry& entry : allFaults()) {
        const auto one = Faults::parse(entry.name);
        ASSERT_TRUE(one) << entry.name;
        for (const FaultEntry& other : allFaults()) EXPECT_EQ(one->has(other.fault), other.fault == entry.fault);
    }
}

}  // namespace
}  // namespace kelvo::modem
