#pragma once

#include <gtest/gtest.h>

#include <algorithm>
#include <map>
#include <string>
#include <vector>

#include "telephony/simulation/GSMUMTS/Simulation.h"
#include "tests/telephony/simulation/Played.h"

namespace kelvo::test {

using namespace simulation;
using namespace simulation::gsm;

/// One message after another, each compared with the world at that moment.
class GsmComparison {
public:
    using Labels = std::map<int, std::string>;

    explicit GsmComparison(gsm::Simulation& modem) : _modem(modem), _played(modem) {}

    void next() {
        const std::uint32_t code = _played.next();
        SCOPED_TRACE(testing::Message() << "record 0x" << std::hex << code << " at " << std::dec
                                        << seconds(_played.time()) << " s");
        compare(code);
    }
    Played& played() { return _played; }

private:
    template <class State>
    static std::string label(const Labels& labels, State state) {
        const auto found = labels.find(static_cast<int>(state));
        return found == labels.end() ? "(no label stated)" : found->second;
    }

    void compare(std::uint32_t code);
    void compareMobility(std::uint32_t code);
    void compareGsm(std::uint32_t code);
    void compareGprs(std::uint32_t code);
    void compareUmts(std::uint32_t code);

    void servingNetwork();
    void equivalents();
    void gsmMeasurement();
    void gsmNeighbors();
    void rememberBsics();
    void mobileAllocation();
    void searcher();
    void ranking();
    void rankedUmts();
    void rankedGsm();
    void transmitPower();
    void blockErrors();
    void hsdpa();
    void processes(const std::string& path, const std::vector<HarqProcess>& expected);
    void sim();
    void cells();
    void umtsNeighborsOfArray();
    void gsmNeighborsOfArray();
    void contexts();

    void shows(const std::string& path, const std::string& expected) {
        EXPECT_EQ(_played.text(_group + path), expected) << path;
    }
    void shows(const std::string& path, int expected) { shows(path, std::to_string(expected)); }
    void within(const std::string& path, double truth, double halfStep, const std::string& unit = "") {
        EXPECT_NEAR(numberBefore(unit, path), truth, halfStep + 1e-6) << path;
    }
    /// RXLEV r tells of -111 + r to -110 + r dBm; both ends are open.
    void levelWithin(const std::string& path, double dBm, const std::string& unit = "") {
        const double shown = numberBefore(unit, path);
        EXPECT_TRUE(shown == 0 || dBm >= shown - 111) << path << " shows " << shown << " for " << dBm;
        EXPECT_TRUE(shown == 63 || dBm < shown - 110) << path << " shows " << shown << " for " << dBm;
    }

    /// The number shown, which nothing but this unit follows.
    double numberBefore(const std::string& unit, const std::string& path) {
        const std::string text = _played.text(_group + path);
        EXPECT_EQ(text.substr(std::min(text.size(), text.find_first_not_of("-.0123456789"))), unit) << path;
        return _played.number(_group + path);
    }

    const GsmCell& gsmCell() const { return _modem.network().gsmCells[_modem.modem().serving()]; }
    const UmtsCell& umtsCell() const { return _modem.network().umtsCells[_modem.modem().serving()]; }

    gsm::Simulation& _modem;
    Played _played;
    std::string _group;  // the screen that paths begin at
    std::map<int, int> _bsics;
};

}  // namespace kelvo::test
