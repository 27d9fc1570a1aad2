// A drive of a newer modem, turned into the fixed layouts, is the same drive on the screens.
#include <gtest/gtest.h>

#include <cmath>
#include <cstdlib>
#include <map>
#include <set>

#include "LogGenerator/Factory.h"
#include "LogGenerator/Framing.h"
#include "platform/system/DirectoryResources.h"
#include "platform/system/Environment.h"
#include "telephony/adaptation/RecordAdapter.h"
#include "telephony/simulation/GSMUMTS/Simulation.h"
#include "telephony/simulation/LTE/Simulation.h"
#include "telephony/simulation/MakeSimulation.h"

using namespace kelvo;
using namespace kelvo::simulation;
using namespace std::chrono_literals;

namespace {

using adaptation::Adapted;
using Texts = std::map<std::string, std::string>;

/// What is shown, by path, as "Neighbor Cells List/0/Srxlev".
void collect(const Value& value, const std::string& path, Texts& texts) {
    if (value.array()) {
        std::size_t row = 0;
        for (const Value& entry : *value.array()) collect(entry, path + "/" + std::to_string(row++), texts);
    } else if (value.dictionary()) {
        for (const auto& [key, entry] : *value.dictionary()) {
            const std::string shown = std::string(key).substr(std::string(key).find(';') + 1);
            collect(entry, path.empty() ? shown : path + "/" + shown, texts);
        }
    } else if (value.string() != nullptr) {
        texts[path] = *value.string();
    }
}

/// A modem's log on the screens, through the adapter.
class Screens {
public:
    explicit Screens(std::unique_ptr<simulation::Simulation> modem)
        : _modem(std::move(modem)),
          _generator(generatorFromTechnology(namesOf(_modem->technology()).identifier)),
          _message(_modem->next()) {}

    Time next() const { return _message.time; }
    /// Feeds the messages of that time; the codes of those that came out of the adapter.
    std::multiset<LogCode> play(Time time) {
        std::multiset<LogCode> codes;
        for (; _message.time == time; _message = _modem->next()) {
            const Adapted adapted = _adapter.adapt(stripPrefix(_message.bytes));
            outcomes[adapted.outcome] += 1;
            if (adapted.outcome == Adapted::Outcome::Refused) continue;
            _generator->updateState(_state, adapted.packet);
            codes.insert(logCode(adapted.packet.data()));
        }
        return codes;
    }
    Texts texts() const {
        Texts texts;
        if (const Value* display = _state.find("Display")) collect(*display, "", texts);
        return texts;
    }

    std::map<Adapted::Outcome, int> outcomes;

private:
    DirectoryResources _resources{KELVO_RESOURCE_DIR};
    Environment::Scope _environment{{.resources = &_resources}};
    std::unique_ptr<simulation::Simulation> _modem;
    std::unique_ptr<LogGenerator> _generator;
    Dictionary _state;
    adaptation::RecordAdapter _adapter;
    simulation::Simulation::Message _message;
};

double number(const std::string& text) { return std::strtod(text.c_str(), nullptr); }

/// The step of the fixed layout in which a level is shown, by the end of its path; 0: no level, shown as it is.
double stepOf(const std::string& path) {
    const bool isNeighbor = path.starts_with("Neighbor Cells List/");
    const auto ends = [&path](std::string_view end) { return path.ends_with(end); };
    if (ends("Filtered RSRP")) return 0.25;
    if (ends("Filtered RSRQ")) return 0.125;
    if (ends("Measured RSRP") || ends("Average RSRP")) return isNeighbor ? 0.5 : 0.25;
    if (ends("Measured RSRQ") || ends("Average RSRQ")) return 0.25;
    if (ends("Measured RSSI")) return 0.5;
    return 0;
}

/// Whether a newer modem's text says what the fixed layout's says.
bool saysTheSame(const std::string& path, const std::string& fixed, const std::string& newer) {
    if (fixed == newer) return true;
    if (path.ends_with("/Version")) return fixed == "1" && newer == "2";  // adapted records carry 2
    // The newer neighbor's Srxlev has six bits: it goes up to 33 dB.
    if (path.starts_with("Neighbor Cells List/") && path.ends_with("/Srxlev"))
        return number(fixed) > 33 && newer == "33 dBm";
    const double step = stepOf(path);
    const auto unit = [](const std::string& text) { return text.substr(text.find(' ')); };
    return step > 0 && unit(fixed) == unit(newer) && std::abs(number(fixed) - number(newer)) < step + 0.006;
}

constexpr const char* kIdleSection = "Serving Cell Measurements/";

void expectTheSame(const Texts& fixed, const Texts& newer, bool withIdleSection) {
    ASSERT_EQ(fixed.size(), newer.size());
    for (auto one = fixed.begin(), other = newer.begin(); one != fixed.end(); ++one, ++other) {
        ASSERT_EQ(one->first, other->first);
        if (!withIdleSection && one->first.starts_with(kIdleSection)) continue;
        EXPECT_TRUE(saysTheSame(one->first, one->second, other->second))
            << one->first << ": " << one->second << ", and " << other->second;
    }
}

struct LteDrive {
    explicit LteDrive(Generation generation) {
        auto simulation = std::make_unique<lte::Simulation>(1, generation);
        modem = &simulation->modem();
        screens = std::make_unique<Screens>(std::move(simulation));
    }
    const lte::Modem* modem;  // stands after the message that comes next
    std::unique_ptr<Screens> screens;
};

/// Plays both for a minute and compares the screens whenever either has said something.
void expectTheSameDrive(Screens& fixed, Screens& newer) {
    bool isIdleSectionCurrent = true;
    while (fixed.next() < 1min && !testing::Test::HasFailure()) {
        const Time time = std::min(fixed.next(), newer.next());
        SCOPED_TRACE(testing::Message() << "at " << seconds(time) << " s");
        const auto fixedCodes = fixed.play(time);
        const auto newerCodes = newer.play(time);
        // A connected phone's 0xb193 tells of the serving cell, of which the older modem says nothing then.
        if (newerCodes.contains(0xB17F)) isIdleSectionCurrent = fixedCodes.contains(0xB17F);
        expectTheSame(fixed.texts(), newer.texts(), isIdleSectionCurrent);
    }
    EXPECT_EQ(fixed.outcomes[Adapted::Outcome::Turned], 0);
    EXPECT_EQ(fixed.outcomes[Adapted::Outcome::Refused], 0);
    EXPECT_GT(newer.outcomes[Adapted::Outcome::Turned], 0);
    EXPECT_EQ(newer.outcomes[Adapted::Outcome::Refused], 0);
}

/// The kinds of records that a modem sends in three minutes, as "0xB0C1 version 2, 11 bytes".
std::set<std::string> kindsSentBy(Technology technology, Generation generation) {
    const auto modem = makeSimulation(technology, 1, generation);
    adaptation::RecordAdapter adapter;
    std::set<std::string> kinds;
    for (auto message = modem->next(); message.time < 3min; message = modem->next())
        kinds.insert(adaptation::describe(adapter.adapt(stripPrefix(message.bytes)).kind));
    return kinds;
}
/// Those of a code.
std::set<std::string> of(const std::set<std::string>& kinds, const std::string& code) {
    std::set<std::string> found;
    std::ranges::copy_if(kinds, std::inserter(found, found.end()),
                         [&](const std::string& kind) { return kind.starts_with(code); });
    return found;
}
/// Whether there are some of the code, all of the version; their lengths differ with their lists.
bool areAll(const std::set<std::string>& kinds, const std::string& code, const std::string& version) {
    const auto found = of(kinds, code);
    return !found.empty() && of(found, code + version) == found;
}

}  // namespace

TEST(Generations, OfFixedLayoutsPassTheAdapterByteForByte) {
    for (const Technology technology : {Technology::LTE, Technology::GSM, Technology::CDMA, Technology::UTRAN}) {
        const auto modem = makeSimulation(technology, 1);
        adaptation::RecordAdapter adapter;
        for (auto message = modem->next(); message.time < 1min; message = modem->next()) {
            const Adapted adapted = adapter.adapt(stripPrefix(message.bytes));
            ASSERT_EQ(adapted.outcome, Adapted::Outcome::Passed) << adaptation::describe(adapted.kind);
        }
    }
}

TEST(Generations, ShowTheSameLteDriveWithinTheOlderSteps) {
    for (const Generation generation : {Generation::Of2014, Generation::Of2018}) {
        SCOPED_TRACE(yearOf(generation));
        Screens fixed(makeSimulation(Technology::LTE, 1));
        Screens newer(makeSimulation(Technology::LTE, 1, generation));
        expectTheSameDrive(fixed, newer);
    }
}

TEST(Generations, ShowTheSameGsmAndUmtsDriveToTheLetter) {
    for (const Generation generation : {Generation::Of2014, Generation::Of2018}) {
        SCOPED_TRACE(yearOf(generation));
        Screens fixed(makeSimulation(Technology::GSM, 1));
        Screens newer(makeSimulation(Technology::GSM, 1, generation));
        expectTheSameDrive(fixed, newer);
    }
}

TEST(Generations, TellOfAConnectedPhonesServingCellAsWell) {
    for (const Generation generation : {Generation::Of2014, Generation::Of2018}) {
        SCOPED_TRACE(yearOf(generation));
        LteDrive drive(generation);
        int connected = 0;
        while (drive.screens->next() < 20s && !HasFailure()) {
            // The world stands where the next message tells of it: what it measured is on the screens once that is fed.
            const bool isConnected = drive.modem->isConnected() && drive.modem->hasMeasured();
            const lte::Reading reading = drive.modem->reading();
            const lte::Cell cell = drive.modem->serving();
            const auto codes = drive.screens->play(drive.screens->next());
            if (!isConnected || !codes.contains(0xB17F)) continue;
            ++connected;
            Texts shown = drive.screens->texts();
            const auto level = [&](const std::string& key) { return number(shown[kIdleSection + key]); };
            const double average = generation == Generation::Of2014 ? reading.rsrp : reading.filteredRsrp;
            EXPECT_EQ(shown[kIdleSection + std::string("E-ARFCN")], std::to_string(cell.carrier.downlink));
            EXPECT_EQ(shown[kIdleSection + std::string("Physical Cell ID")], std::to_string(cell.pci));
            EXPECT_NEAR(level("Measured RSRP"), reading.rsrp, 0.16);  // half a step of each layout
            EXPECT_NEAR(level("Average RSRP"), average, 0.16);
            EXPECT_NEAR(level("Measured RSRQ"), reading.rsrq, 0.16);
            EXPECT_NEAR(level("Measured RSSI"), reading.rssi, 0.285);
        }
        EXPECT_GT(connected, 20);
    }
}

TEST(Generations, SendTheLayoutsOfTheirYear) {
    const auto lte2014 = kindsSentBy(Technology::LTE, Generation::Of2014);
    EXPECT_EQ(of(lte2014, "0xB0C1"), std::set<std::string>{"0xB0C1 version 2, 11 bytes"});
    EXPECT_EQ(of(lte2014, "0xB0C2"), std::set<std::string>{"0xB0C2 version 3, 29 bytes"});
    EXPECT_TRUE(areAll(lte2014, "0xB179", " version 3, "));
    EXPECT_EQ(of(lte2014, "0xB17F"), std::set<std::string>{"0xB17F version 4, 32 bytes"});
    EXPECT_TRUE(areAll(lte2014, "0xB180", " version 4, "));
    EXPECT_EQ(of(lte2014, "0xB193"), std::set<std::string>{"0xB193 version 1, part 25 version 19, 364 bytes"});

    const auto lte2018 = kindsSentBy(Technology::LTE, Generation::Of2018);
    EXPECT_EQ(of(lte2018, "0xB0C1"), std::set<std::string>{"0xB0C1 version 3, 12 bytes"});
    EXPECT_EQ(of(lte2018, "0xB0C2"), std::set<std::string>{"0xB0C2 version 3, 29 bytes"});
    EXPECT_TRUE(areAll(lte2018, "0xB179", " version 4, "));
    EXPECT_EQ(of(lte2018, "0xB17F"), std::set<std::string>{"0xB17F version 5, 36 bytes"});
    EXPECT_TRUE(areAll(lte2018, "0xB180", " version 5, "));
    EXPECT_EQ(of(lte2018, "0xB193"), std::set<std::string>{"0xB193 version 1, part 25 version 36, 524 bytes"});

    const auto gsm2014 = kindsSentBy(Technology::GSM, Generation::Of2014);
    EXPECT_TRUE(areAll(gsm2014, "0x4005", " version 1, "));
    EXPECT_EQ(of(gsm2014, "0x4127"), std::set<std::string>{"0x4127, 32 bytes"});
    EXPECT_EQ(of(gsm2014, "0x7150"), std::set<std::string>{"0x7150, 19 bytes"});
    EXPECT_FALSE(of(gsm2014, "0x51FC").empty());
    EXPECT_TRUE(of(gsm2014, "0x5137").empty());
    EXPECT_FALSE(of(gsm2014, "0x5134").empty());
    EXPECT_TRUE(of(gsm2014, "0x5B").empty());

    const auto gsm2018 = kindsSentBy(Technology::GSM, Generation::Of2018);
    EXPECT_TRUE(areAll(gsm2018, "0x4005", " version 2, "));
    for (const char* code : {"0x5A72", "0x5A76", "0x5B2C", "0x5B34", "0x5BF4", "0x5BF5", "0x5BF6", "0x5BF8", "0x5BFB",
                             "0x5BFC", "0x5BFD", "0x5BFF"}) {
        EXPECT_FALSE(of(gsm2018, code).empty()) << code;
    }
    for (const char* code : {"0x50", "0x51"}) EXPECT_TRUE(of(gsm2018, code).empty()) << code;
}

TEST(Generations, AreThoseOfLteAndGsmAlone) {
    EXPECT_EQ(generationOf(Technology::LTE, "2010").value(), Generation::Of2010);
    EXPECT_EQ(generationOf(Technology::LTE, "2014").value(), Generation::Of2014);
    EXPECT_EQ(generationOf(Technology::GSM, "2018").value(), Generation::Of2018);
    EXPECT_EQ(generationOf(Technology::LTE, "2015").error().reason, "2015 is none of 2010, 2014, 2018");
    EXPECT_EQ(generationOf(Technology::UTRAN, "2014").error().reason,
              "UTRAN records have one layout, whatever the year: only lte and gsm have generations");
}
