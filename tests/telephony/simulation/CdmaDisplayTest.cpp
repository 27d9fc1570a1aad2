// What the CDMA2000 screens show of a simulated drive, held against the world that was simulated.
#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <map>
#include <optional>
#include <set>

#include "telephony/simulation/CDMA/Simulation.h"
#include "tests/telephony/simulation/Played.h"

using namespace kelvo;
using namespace kelvo::simulation;
using namespace kelvo::simulation::cdma;
using namespace std::chrono_literals;

namespace {

constexpr Time kDrive = 10min;
constexpr double kPrinted = 0.0051;  // two decimals

const std::map<OneXState, std::string> kOneXStates{
    {OneXState::Initial, "Initial state for CDMA operation [2]"},
    {OneXState::Acquisition, "Acquisition [3]"},
    {OneXState::Sync, "Sync [4]"},
    {OneXState::Slew, "Slew [5]"},
    {OneXState::Paging, "Paging [6]"},
    {OneXState::Sleep, "Slotted mode sleep state [7]"},
    {OneXState::Traffic, "Traffic [8]"},
    {OneXState::Powerup, "Powerup state [11]"},
};
const std::map<EvdoState, std::string> kEvdoStates{
    {EvdoState::Inactive, "Inactive [0]"}, {EvdoState::Acquisition, "Acquisition [1]"},
    {EvdoState::Sync, "Sync [2]"},         {EvdoState::Idle, "Idle [3]"},
    {EvdoState::Access, "Access [4]"},     {EvdoState::Connected, "Connected [5]"},
};
const std::map<SessionState, std::string> kSessionStates{
    {SessionState::Closed, "Closed [0]"},
    {SessionState::AddressSetup, "AMP setup [1]"},
    {SessionState::PhoneNegotiates, "AT-initiated neg [2]"},
    {SessionState::NetworkNegotiates, "Initiated neg [3]"},
    {SessionState::Open, "Open [4]"},
};
const std::map<int, std::string> kRoamingIndicators{{0, "OFF [0]"}, {1, "ON [1]"}, {64, "ERI - 64"}};

double ratio(double decibels) { return std::pow(10, decibels / 10); }

/// One list of pilots as the screen has it: "position;PN" and the text, in the dictionary's order.
std::vector<std::pair<std::string, std::string>> rowsOf(const Value* list) {
    std::vector<std::pair<std::string, std::string>> rows;
    if (list == nullptr || !list->dictionary()) return rows;
    for (const auto& [key, value] : *list->dictionary()) {
        if (key != "_sorted") rows.emplace_back(key, value.string() != nullptr ? *value.string() : "");
    }
    return rows;
}

std::string rowKey(std::size_t position, int pn) { return std::to_string(position) + ";" + std::to_string(pn); }

/// A ratio is told in `step`s of it, and printed in dB with two decimals.
void expectRatio(const std::string& shown, double decibels, double step) {
    const double slack = ratio(decibels) * (ratio(kPrinted) - 1);
    EXPECT_NEAR(ratio(std::stod(shown)), ratio(decibels), step / 2 + slack) << shown << " for " << decibels;
    EXPECT_TRUE(shown.ends_with(" dB")) << shown;
}

}  // namespace

class CdmaDisplay : public testing::Test {
protected:
    void near(const char* path, double truth, double step, const char* unit) {
        const std::string shown = played.text(path);
        EXPECT_NEAR(played.number(path), truth, step / 2 + kPrinted) << path << " shows " << shown;
        EXPECT_TRUE(shown.ends_with(unit)) << path << " shows " << shown;
    }
    void is(const char* path, const std::string& text) { EXPECT_EQ(played.text(path), text) << path; }

    void checkOneX() {
        const OneXStatus& truth = modem.modem().oneX().status();
        is("1x/State", kOneXStates.at(truth.state));
        is("1x/Rx0 Band Class", "800 MHz cellular band [0]");
        is("1x/Rx0 Channel", "283");
        near("1x/Rx0 AGC", truth.rx0, 0.334, " dBm");
        checkOneXActiveSet(truth);
        if (truth.state == OneXState::Traffic) {
            is("1x/Rx1 Band Class", "800 MHz cellular band [0]");
            is("1x/Rx1 Channel", "283");
            near("1x/Rx1 AGC", truth.rx1, 0.334, " dBm");
            near("1x/Tx AGC", truth.tx, 0.1, " dBm");
            return;
        }
        for (const char* path : {"1x/Rx1 Band Class", "1x/Rx1 Channel", "1x/Rx1 AGC", "1x/Tx AGC"}) is(path, "N/A");
        if (!errors) return;
        near("1x/Traffic FER", *errors * 100, 0, "% (old)");
        near("Rates and Errors/1x Traffic FER", *errors * 100, 0, "% (old)");
        errors.reset();
    }
    void checkOneXActiveSet(const OneXStatus& truth) {
        const auto rows = rowsOf(played.at("1x/Active Set"));
        ASSERT_EQ(rows.size(), truth.active.size());
        for (std::size_t i = 0; i < rows.size(); ++i) {
            const auto& [pn, strength] = truth.active[i];
            EXPECT_EQ(rows[i].first, rowKey(i, pn));
            const std::string mark = pn == truth.referencePn ? "(ref pilot) " : "";
            ASSERT_EQ(rows[i].second.substr(0, mark.size()), mark);
            expectRatio(rows[i].second.substr(mark.size()), strength, 1 / 55296.0);
        }
    }
    void checkFrame() {
        errors = errors.value_or(0) * 63 / 64 + (modem.modem().oneX().status().frameErased ? 1 / 64.0 : 0);
        near("1x/Traffic FER", *errors * 100, 0, "%");
        near("Rates and Errors/1x Traffic FER", *errors * 100, 0, "%");
    }
    void checkSystem() {
        const System& truth = modem.modem().oneX().system();
        is("System/Roaming Indicator", kRoamingIndicators.at(truth.roamingIndicator));
        const bool found = truth.type == 2;
        is("System/System ID", found ? std::to_string(truth.sid) : "(unknown system type 0)");
        is("System/Network ID", found ? std::to_string(truth.nid) : "(unknown system type 0)");
        is("System/Base Station ID", std::to_string(truth.baseId));
        is("System/Packet Zone ID", std::to_string(truth.packetZone));
        is("System/Protocol Revision", std::to_string(truth.protocolRevision));
        systems.insert({truth.sid, truth.nid});
    }
    void checkEvdo() {
        const EvdoStatus& truth = modem.modem().evdo().status();
        is("EV-DO/Device State", kEvdoStates.at(truth.state));
        is("EV-DO/Session State", kSessionStates.at(truth.session));
        is("EV-DO/Channel", "475");
        is("EV-DO/Band Class", "1.8 to 2.0GHz PCS band [1]");
        is("EV-DO/Color Code", std::to_string(truth.colorCode));
        char uati[16];
        std::snprintf(uati, sizeof uati, "0x%06x", truth.uati);
        is("EV-DO/UATI24", uati);
        is("EV-DO/Serving PN Offset",
           truth.servingPn ? std::to_string(*truth.servingPn) + " \u00d7 64chips" : "Invalid Value");
        near("EV-DO/Rx0 AGC", truth.rx0, 1, " dBm");
        const bool sends = truth.state == EvdoState::Access || truth.state == EvdoState::Connected;
        if (sends) {
            near("EV-DO/Rx1 AGC", truth.rx1, 1, " dBm");
            near("EV-DO/Tx AGC", truth.tx, 1, " dBm");
        } else {
            is("EV-DO/Rx1 AGC", "N/A");
            is("EV-DO/Tx AGC", "N/A");
        }
        evdoStates.insert(truth.state);
        sessionStates.insert(truth.session);
    }
    void checkPilots() {
        const auto& truth = modem.modem().evdo().status().active;
        if (truth.empty()) return is("EV-DO/Active Set", "(none)");
        const auto rows = rowsOf(played.at("EV-DO/Active Set"));
        ASSERT_EQ(rows.size(), truth.size());
        for (std::size_t i = 0; i < rows.size(); ++i) {
            EXPECT_EQ(rows[i].first, rowKey(i, truth[i].pn));
            expectRatio(rows[i].second, truth[i].strength, 1 / 512.0);
        }
    }
    void checkFingers() {
        const auto& truth = modem.modem().evdo().status().fingers;
        std::vector<std::pair<std::string, double>> locked;
        for (std::size_t i = 0; i < truth.size(); ++i) {
            if (truth[i].pn) locked.emplace_back(rowKey(i, *truth[i].pn), truth[i].carrierToInterference);
        }
        if (locked.empty()) return is("EV-DO/Fingers", "(none)");
        const auto rows = rowsOf(played.at("EV-DO/Fingers"));
        ASSERT_EQ(rows.size(), locked.size());
        for (std::size_t i = 0; i < rows.size(); ++i) {
            EXPECT_EQ(rows[i].first, locked[i].first);
            expectRatio(rows[i].second, locked[i].second, 1 / 512.0);
        }
    }

    struct Total {
        std::uint64_t bits;
        Time time;
    };
    void checkRate(const char* path, std::optional<Total>& last, std::uint64_t bits) {
        if (last) {
            const double took = seconds(played.time() - last->time);
            near(path, static_cast<double>(bits - last->bits) / 1024 / took, 0, " kbps");
            fastest[path] = std::max(fastest[path], played.number(path));
        } else {
            is(path, "");
        }
        last = Total{bits, played.time()};
    }

    void check(std::uint32_t code) {
        const PacketCounters& packets = modem.modem().evdo().counters();
        switch (code) {
            case 0x119C: return checkOneX();
            case 0x119D: return checkFrame();
            case 0x134F: return checkSystem();
            case 0x1183: return checkEvdo();
            case 0x12B6: return checkPilots();
            case 0x108A: return checkFingers();
            case 0x1192: return checkRate("Rates and Errors/EV-DO Forward Rate", forward, packets.forwardBits);
            case 0x127E: return checkRate("Rates and Errors/EV-DO Reverse Rate", reverse, packets.reverseBits);
            default: FAIL() << "a record that nobody asked for: " << code;
        }
    }

    cdma::Simulation modem{1};
    test::Played played{modem};
    std::optional<double> errors;
    std::optional<Total> forward;
    std::optional<Total> reverse;
    std::map<std::string, double> fastest;
    std::set<std::pair<int, int>> systems;
    std::set<EvdoState> evdoStates;
    std::set<SessionState> sessionStates;
};

TEST_F(CdmaDisplay, ShowsTheWorldAsItIsForTenMinutes) {
    while (played.time() < kDrive) {
        const std::uint32_t code = played.next();
        check(code);
        if (HasFailure()) FAIL() << "at " << seconds(played.time()) << " s, code " << std::hex << code;
    }
    for (const auto& [level, line] : played.log()) EXPECT_GT(level, 3) << line;
    EXPECT_GE(systems.size(), 3U);  // none at first, then one after another
    EXPECT_EQ(evdoStates.size(), 6U);
    EXPECT_EQ(sessionStates.size(), 5U);
    EXPECT_GT(fastest["Rates and Errors/EV-DO Forward Rate"], 500);
    EXPECT_GT(fastest["Rates and Errors/EV-DO Reverse Rate"], 50);
}

namespace {

/// An active set of a connected phone, as the screens show it: how far each pilot stood above the one that is followed
/// since this one is.
class ShownPilots {
public:
    void forget() {
        _followed.clear();
        _above.clear();
    }
    /// `rows`: position and PN offset, and the strength, perhaps after a mark.
    void look(const std::string& followed, const std::vector<std::pair<std::string, std::string>>& rows) {
        std::map<std::string, double> strengths;
        for (const auto& [key, text] : rows) {
            strengths[key.substr(key.find(';') + 1)] = std::stod(text.substr(text.find(')') + 1));
        }
        ASSERT_TRUE(strengths.contains(followed));
        if (!_followed.empty() && followed != _followed) {
            const auto& before = _above[followed];
            ASSERT_FALSE(before.empty()) << followed << " was not shown";
            double last = before.back();
            if (strengths.contains(_followed)) {
                last = strengths[followed] - strengths[_followed];
                EXPECT_GT(last, 2.98);  // 3 dB, less what is not printed
            }
            ++changes;
            rising += last > before.front();
            _above.clear();
        }
        _followed = followed;
        for (const auto& [pn, strength] : strengths) _above[pn].push_back(strength - strengths[followed]);
    }

    int changes = 0;
    int rising = 0;

private:
    std::string _followed;
    std::map<std::string, std::vector<double>> _above;
};

}  // namespace

TEST_F(CdmaDisplay, FollowsOnlyPilotsThatItHasShownBeforeAndThatCameCloser) {
    ShownPilots oneX;
    ShownPilots evdo;
    while (played.time() < kDrive) {
        const std::uint32_t code = played.next();
        if (code == 0x119C) {
            if (played.text("1x/State") != "Traffic [8]") {
                oneX.forget();
                continue;
            }
            const auto rows = rowsOf(played.at("1x/Active Set"));
            const auto isReference = [](const auto& row) { return row.second.starts_with("(ref pilot)"); };
            const auto reference = std::ranges::find_if(rows, isReference);
            ASSERT_NE(reference, rows.end());
            oneX.look(reference->first.substr(reference->first.find(';') + 1), rows);
        } else if (code == 0x12B6) {  // comes after 0x1183, which tells who serves
            if (played.text("EV-DO/Device State") != "Connected [5]") {
                evdo.forget();
                continue;
            }
            const std::string serving = played.text("EV-DO/Serving PN Offset");
            evdo.look(serving.substr(0, serving.find(' ')), rowsOf(played.at("EV-DO/Active Set")));
        }
        if (HasFatalFailure()) FAIL() << "at " << seconds(played.time()) << " s";
    }
    EXPECT_GE(oneX.changes, 20);
    EXPECT_GE(oneX.rising, oneX.changes * 3 / 4) << oneX.changes;
    EXPECT_GE(evdo.changes, 20);
    EXPECT_GE(evdo.rising, evdo.changes * 3 / 4) << evdo.changes;
}

TEST_F(CdmaDisplay, FillsEveryScreenWithinTwoSeconds) {
    while (played.time() < 2s) played.next();
    for (const char* path : {"1x/State", "1x/Rx0 AGC", "1x/Tx AGC", "EV-DO/Device State", "EV-DO/Serving PN Offset",
                             "Rates and Errors/EV-DO Forward Rate", "Rates and Errors/EV-DO Reverse Rate",
                             "System/System ID", "System/Base Station ID"}) {
        EXPECT_NE(played.text(path), "") << path;
    }
    EXPECT_EQ(rowsOf(played.at("1x/Active Set")).size(), 1U);
    EXPECT_FALSE(rowsOf(played.at("EV-DO/Active Set")).empty());
    EXPECT_FALSE(rowsOf(played.at("EV-DO/Fingers")).empty());
}
