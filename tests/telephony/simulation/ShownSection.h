#pragma once

#include <gtest/gtest.h>

#include "tests/telephony/simulation/Played.h"

namespace kelvo::test {

/// One section of the screens at a time, held against the simulated world; differences are test failures.
class ShownSection {
protected:
    explicit ShownSection(Played& played) : _played(played) {}

    /// The section, or the row of a list, that keys belong to from now on.
    void open(std::string path) { _section = std::move(path); }

    std::string at(const std::string& key) { return _played.text(_section + "/" + key); }
    std::size_t rows(const std::string& key) { return _played.rows(_section + "/" + key); }
    double number(const std::string& key) { return _played.number(_section + "/" + key); }
    void equals(const std::string& key, const std::string& text) { EXPECT_EQ(at(key), text) << _section << "/" << key; }
    void equals(const std::string& key, std::int64_t number) { equals(key, std::to_string(number)); }
    /// A reading shown in steps of `step`, with two decimals and its unit.
    void reads(const std::string& key, double truth, double step, const std::string& unit) {
        EXPECT_NEAR(number(key), truth, step / 2 + 0.00501) << _section << "/" << key;
        EXPECT_TRUE(at(key).ends_with(unit)) << _section << "/" << key << ": " << at(key);
    }

    Played& _played;

private:
    std::string _section;
};

}  // namespace kelvo::test
