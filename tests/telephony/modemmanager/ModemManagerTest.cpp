#include "telephony/modemmanager/ModemManager.h"

#include <gtest/gtest.h>
#include <unistd.h>

#include "platform/system/Environment.h"
#include "tests/support/EventLoop.h"
#include "tests/support/ManualQueue.h"
#include "tests/support/PrivateBus.h"
#include "tests/support/RecordingLog.h"
#include "tests/telephony/modemmanager/MockManager.h"

namespace kelvo::modemmanager {
namespace {

using namespace std::chrono_literals;
using phone::MonitoredCell;
using test::MockManager;
using Cell = MonitoredCell::Technology;

constexpr const char* kUnauthorized = "org.freedesktop.ModemManager1.Error.Core.Unauthorized";
constexpr const char* kUnsupportedCall = "org.freedesktop.ModemManager1.Error.Core.Unsupported";
constexpr const char* kAccessDenied = "org.freedesktop.DBus.Error.AccessDenied";

const QVariantMap kServingLte{{"cell-type", 5U}, {"serving", true}, {"operator-id", "00101"},
                              {"tac", "7"},      {"ci", "1234501"}, {"physical-ci", "12D"},
                              {"earfcn", 1300U}, {"rsrp", -100.0},  {"rsrq", -8.0}};

class ModemManagerTest : public testing::Test {
protected:
    void SetUp() override {
        if (!bus) GTEST_SKIP() << "no bus is installed";
        mock = std::make_unique<MockManager>(bus.address());
    }
    void follow(const std::string& wanted = "", uid_t owner = ::getuid()) {
        manager = std::make_unique<ModemManager>(
            [this] { return QDBusConnection::connectToBus(bus.address(), "follower"); }, owner, wanted, queue);
        manager->follow([this] { ++changes; });
    }
    // With a modem, its SIM and its bearers.
    void followModem(const std::string& wanted = "") {
        if (mock->modems.empty()) mock->addModem(0);
        follow(wanted);
        ASSERT_TRUE(
            until([this] { return !phone().sim.iccid.empty() && phone().contexts && !phone().contexts->empty(); }));
    }
    template <class Condition>
    bool until(Condition condition) {
        return test::runUntil([&] {
            queue.run();
            return condition();
        });
    }
    // What has been sent has arrived: an answer on the same road has.
    void settle() {
        const int calls = changes;
        mock->change(0, test::kModemInterface, {{"Model", QString("again %1").arg(calls)}});
        ASSERT_TRUE(until([&] { return phone().model == "Maker again " + std::to_string(calls); }));
    }
    const phone::PhoneState& phone() const { return manager->phone(); }
    std::size_t lines(std::string_view words) const {
        return static_cast<std::size_t>(std::ranges::count_if(
            log.lines(), [&](const auto& line) { return line.second.find(words) != std::string::npos; }));
    }

    test::PrivateBus bus;
    test::ManualQueue queue;
    test::RecordingLog log;
    Environment::Scope scope{Environment{.log = &log}};
    std::unique_ptr<MockManager> mock;
    std::unique_ptr<ModemManager> manager;
    int changes = 0;
};

TEST_F(ModemManagerTest, TellsModemSimAndBearers) {
    followModem();
    EXPECT_EQ(manager->trouble(), "");
    EXPECT_EQ(phone().modem, "0");
    EXPECT_EQ(phone().model, "Maker Model 0");
    EXPECT_EQ(phone().equipment, "860000000000000");
    EXPECT_EQ(phone().condition, "registered");
    EXPECT_EQ(phone().registration, "home");
    EXPECT_EQ(phone().network, "Test Network");
    EXPECT_EQ(phone().simOperator, "Provider");
    EXPECT_EQ(phone().access, "LTE");
    EXPECT_EQ(phone().family, Technology::LTE);
    EXPECT_EQ(phone().sim.iccid, "8900101000000123450");
    EXPECT_EQ(phone().sim.msisdn, "+15550123");
    const phone::PdpContext context{.id = 1,
                                    .apn = "internet",
                                    .type = "IPv4",
                                    .state = "Active",
                                    .address = "10.20.30.40",
                                    .qos = "150000 kbps down, 50000 kbps up"};
    EXPECT_EQ(phone().contexts, std::vector{context});
    EXPECT_FALSE(mock->asked.contains("GetCellInfo"));  // nobody measures
    EXPECT_TRUE(mock->rates.isEmpty());
}

TEST_F(ModemManagerTest, FollowsWhatChanges) {
    followModem();
    mock->change(0, test::kModemInterface, {{"AccessTechnologies", 1U << 5}, {"State", 11}});
    mock->changePart(MockManager::bearerPath(0), "org.freedesktop.ModemManager1.Bearer", {{"Connected", false}});
    ASSERT_TRUE(until([this] { return phone().contexts->front().state == "Inactive"; }));
    EXPECT_EQ(phone().family, Technology::GSM);
    EXPECT_EQ(phone().access, "UMTS");
    EXPECT_EQ(phone().condition, "connected");
    const auto none = QVariant::fromValue(QList<QDBusObjectPath>());
    mock->change(0, test::kModemInterface, {{"Bearers", none}});
    EXPECT_TRUE(until([this] { return phone().contexts->empty(); }));
}

TEST_F(ModemManagerTest, ShowsTheBearerOfTheAttachFirst) {
    mock->addModem(0);
    mock->parts[MockManager::bearerPath(9)] = {{"Connected", true},
                                               {"Properties", QVariantMap{{"apn", "ims"}, {"ip-type", 4U}}}};
    mock->modems[0]["org.freedesktop.ModemManager1.Modem.Modem3gpp"]["InitialEpsBearer"] =
        QVariant::fromValue(QDBusObjectPath(MockManager::bearerPath(9)));
    follow();
    ASSERT_TRUE(until([this] { return phone().contexts && phone().contexts->size() == 2; }));
    EXPECT_EQ(phone().contexts->front(),
              (phone::PdpContext{.id = std::nullopt, .apn = "ims", .type = "IPv4v6", .state = "Active"}));
}

TEST_F(ModemManagerTest, AsksForSignalValuesWhileSomebodyMeasuresAndLeavesTheRateAsItWas) {
    followModem();
    manager->measure(true);
    ASSERT_TRUE(until([this] { return mock->rates == QList<uint>{1}; }));
    settle();
    manager->measure(false);
    ASSERT_TRUE(until([this] { return mock->rates.size() == 2; }));
    EXPECT_EQ(mock->rates, (QList<uint>{1, 0}));

    mock->change(0, "org.freedesktop.ModemManager1.Modem.Signal", {{"Rate", 30U}});  // somebody else's
    settle();
    manager->measure(true);
    ASSERT_TRUE(until([this] { return mock->rates.size() == 3; }));
    settle();
    bool done = false;
    manager->release([&] { done = true; });
    ASSERT_TRUE(until([&] { return done; }));
    EXPECT_EQ(mock->rates, (QList<uint>{1, 0, 1, 30}));
}

TEST_F(ModemManagerTest, ReleasesAtOnceWhatItHasNotAskedFor) {
    followModem();
    bool done = false;
    manager->release([&] { done = true; });
    EXPECT_TRUE(done);
    EXPECT_TRUE(mock->rates.isEmpty());
}

TEST_F(ModemManagerTest, ReleasesADaemonThatHangsAfterASecond) {
    followModem();
    manager->measure(true);
    ASSERT_TRUE(until([this] { return mock->rates.size() == 1; }));
    settle();
    mock->hangs = true;
    bool done = false;
    manager->release([&] { done = true; });
    EXPECT_FALSE(done);
    queue.advance(1s);
    EXPECT_TRUE(done);
}

TEST_F(ModemManagerTest, TellsTheCellsAndLevelsOfLte) {
    mock->cells = {kServingLte, {{"cell-type", 5U}, {"serving", false}, {"physical-ci", "7"}, {"earfcn", 1300U}}};
    followModem();
    manager->measure(true);
    ASSERT_TRUE(until([this] { return phone().cells && phone().cells->size() == 2; }));
    const MonitoredCell serving{.technology = Cell::LTE,
                                .isServing = true,
                                .mcc = 1,
                                .mnc = 1,
                                .tac = 7,
                                .cellId = 0x1234501,
                                .pid = 301,
                                .uarfcn = 1300};
    EXPECT_EQ(phone().cells->front(), serving);
    EXPECT_EQ(phone().cells->back(), (MonitoredCell{.technology = Cell::LTE, .pid = 7, .uarfcn = 1300}));
    EXPECT_EQ(phone().lte, (phone::LteLevels{.rsrp = -100, .rsrq = -8}));
    mock->change(0, "org.freedesktop.ModemManager1.Modem.Signal",
                 {{"Lte", QVariantMap{{"rsrp", -98.0}, {"rsrq", -9.0}, {"rssi", -66.0}}}});
    ASSERT_TRUE(until([this] { return phone().lte.rssi.has_value(); }));
    EXPECT_EQ(phone().lte, (phone::LteLevels{.rsrp = -98, .rsrq = -9, .rssi = -66}));
    EXPECT_FALSE(mock->asked.contains("GetLocation"));  // a cell serves
}

TEST_F(ModemManagerTest, LooksOnceWithoutChangingTheDaemon) {
    mock->cells = {kServingLte};
    followModem();
    bool looked = false;
    manager->look([&] { looked = true; });
    ASSERT_TRUE(until([&] { return looked && phone().cells->front().pid == 301; }));
    EXPECT_TRUE(mock->rates.isEmpty());
    EXPECT_EQ(mock->asked.count("GetCellInfo"), 1);
}

TEST_F(ModemManagerTest, PutsTheLevelsOfGsmAndUmtsIntoTheCellThatServes) {
    mock->addModem(0);
    mock->modems[0][test::kModemInterface]["AccessTechnologies"] = 1U << 4;
    mock->modems[0]["org.freedesktop.ModemManager1.Modem.Signal"] = {
        {"Gsm", QVariantMap{{"rssi", -80.0}}}, {"Umts", QVariantMap{{"rscp", -90.0}, {"ecio", -6.5}}}};
    mock->cells = {{{"cell-type", 2U}, {"serving", true}, {"lac", "9"}, {"ci", "A"}, {"arfcn", 62U}}};
    followModem();
    manager->measure(true);
    ASSERT_TRUE(until([this] { return phone().cells.has_value(); }));
    EXPECT_EQ(phone().cells->front().rssi, -40);
    EXPECT_EQ(phone().family, Technology::GSM);
    mock->cells = {{{"cell-type", 3U}, {"serving", true}, {"uarfcn", 10687U}, {"psc", 5U}}};
    queue.advance(5s);  // asked again
    ASSERT_TRUE(until([this] { return phone().cells->front().technology == Cell::UMTS; }));
    EXPECT_EQ(phone().cells->front().rscp, -90);
    EXPECT_EQ(phone().cells->front().ecn0, -6);
}

TEST_F(ModemManagerTest, KnowsTdScdmaByItsCell) {
    mock->addModem(0);
    mock->modems[0][test::kModemInterface]["AccessTechnologies"] = 1U << 5;
    mock->cells = {{{"cell-type", 4U}, {"serving", true}, {"cell-parameter-id", 100U}}};
    followModem();
    EXPECT_EQ(phone().family, Technology::GSM);
    manager->measure(true);
    EXPECT_TRUE(until([this] { return phone().family == Technology::UTRAN; }));
}

TEST_F(ModemManagerTest, TakesTheCellOfTheRegistrationWhereNoCellInformationIsToBeHad) {
    mock->errors["GetCellInfo"] = kUnsupportedCall;
    mock->location = {{1, QDBusVariant("001,01,0000,000ABCDE,001234")}};
    followModem();
    EXPECT_EQ(phone().cells->front().tac, std::nullopt);  // the network's code is all that is known without asking
    manager->measure(true);
    ASSERT_TRUE(until([this] { return phone().cells->front().tac.has_value(); }));
    EXPECT_EQ(phone().cells->front(),
              (MonitoredCell{
                  .technology = Cell::LTE, .isServing = true, .mcc = 1, .mnc = 1, .tac = 0x1234, .cellId = 0xABCDE}));
    EXPECT_EQ(manager->lacks(), std::vector<std::string>{"cell information: it says no"});
    queue.advance(5s);
    ASSERT_TRUE(until([this] { return mock->asked.count("GetLocation") == 2; }));
    EXPECT_EQ(mock->asked.count("GetCellInfo"), 1);  // what is not there is not asked for again
}

TEST_F(ModemManagerTest, NamesEachMissingRightInOneLine) {
    mock->errors["GetCellInfo"] = kUnauthorized;
    mock->errors["Setup"] = kUnauthorized;
    mock->errors["GetLocation"] = kUnauthorized;
    followModem();
    manager->measure(true);
    ASSERT_TRUE(until([this] { return manager->lacks().size() == 3; }));
    EXPECT_EQ(lines("this user lacks the polkit right org.freedesktop.ModemManager1.Device.Control"), 1U);
    EXPECT_EQ(lines("this user lacks the polkit right org.freedesktop.ModemManager1.Location"), 1U);
    EXPECT_EQ(manager->lacks()[0],
              "cell information: this user lacks the polkit right org.freedesktop.ModemManager1.Device.Control");
    queue.advance(20s);
    settle();
    EXPECT_EQ(mock->asked.count("GetCellInfo"), 1);
    EXPECT_EQ(mock->asked.count("Setup"), 1);
    EXPECT_FALSE(phone().sim.iccid.empty());  // what everybody may know is there
}

TEST_F(ModemManagerTest, NamesThePolicyOfABusThatLetsRootAloneAsk) {
    mock->errors["GetCellInfo"] = kAccessDenied;
    followModem();
    manager->measure(true);
    ASSERT_TRUE(until([this] { return manager->lacks().size() == 1; }));
    EXPECT_EQ(lines("ModemManager gives no cell information: the bus's policy (org.freedesktop.ModemManager1.conf) "
                    "lets root alone call GetCellInfo"),
              1U);
}

TEST_F(ModemManagerTest, TakesTheFirstOfSeveralModemsOrTheOneThatIsNamed) {
    mock->addModem(10);
    mock->addModem(2);
    const std::pair<const char*, const char*> names[] = {
        {"", "2"}, {"10", "10"}, {"/org/freedesktop/ModemManager1/Modem/10", "10"}, {"8600000000000010", "10"}};
    for (const auto& [wanted, index] : names) {
        follow(wanted);
        EXPECT_TRUE(until([this, expected = index] { return phone().modem == expected; })) << wanted;
        manager.reset();
    }
    follow("3");
    EXPECT_TRUE(until([this] { return manager->trouble() == "ModemManager has no such modem"; }));
    EXPECT_EQ(manager->modems().size(), 2U);
    EXPECT_EQ(manager->modems()[1].modem, "10");
}

TEST_F(ModemManagerTest, DescribesItselfWithoutAnIdentity) {
    const auto described = [this](const std::string& wanted) {
        follow(wanted);
        const std::string description = manager->description();
        manager.reset();
        return description;
    };
    EXPECT_EQ(described(""), "ModemManager's first modem");
    EXPECT_EQ(described("3"), "ModemManager's modem 3");
    EXPECT_EQ(described("860000000000000"), "ModemManager's modem of the identity that was named");
}

TEST_F(ModemManagerTest, WaitsForAModemAndFollowsTheNextWhenItGoes) {
    follow();
    ASSERT_TRUE(until([this] { return manager->trouble() == "ModemManager has no modem"; }));
    mock->addModem(1);
    mock->signalModem(1, true);
    ASSERT_TRUE(until([this] { return phone().sim.iccid == "8900101000000123451"; }));
    mock->addModem(2);
    mock->signalModem(2, true);
    mock->signalModem(1, false);
    ASSERT_TRUE(until([this] { return phone().modem == "2" && phone().sim.iccid == "8900101000000123452"; }));
    mock->signalModem(2, false);
    ASSERT_TRUE(until([this] { return phone() == phone::PhoneState{}; }));
    EXPECT_EQ(manager->trouble(), "ModemManager has no modem");
    EXPECT_EQ(lines("ModemManager's modem 2 has gone"), 1U);
}

TEST_F(ModemManagerTest, SaysWhyAModemIsNotRegistered) {
    mock->addModem(0);
    mock->modems[0][test::kModemInterface]["State"] = 2;
    follow();
    EXPECT_TRUE(until([this] { return manager->trouble() == "the modem is locked"; }));
    mock->change(0, test::kModemInterface, {{"State", 8}});
    EXPECT_TRUE(until([this] { return manager->trouble().empty(); }));
}

TEST_F(ModemManagerTest, FollowsADaemonThatLeavesAndReturns) {
    followModem();
    manager->measure(true);
    ASSERT_TRUE(until([this] { return mock->rates.size() == 1; }));
    mock.reset();
    ASSERT_TRUE(until([this] { return manager->trouble() == "ModemManager does not run"; }));
    EXPECT_TRUE(until([this] { return phone() == phone::PhoneState{}; }));
    mock = std::make_unique<MockManager>(bus.address(), "manager again");
    mock->addModem(0);
    mock->signalModem(0, true);
    ASSERT_TRUE(until([this] { return !phone().sim.iccid.empty() && mock->rates.size() == 1; }));  // measured anew
    EXPECT_EQ(manager->trouble(), "");
}

TEST_F(ModemManagerTest, WaitsForNobodyWhenTheDaemonHangs) {
    mock->addModem(0);
    mock->hangs = true;
    follow();
    ASSERT_TRUE(until([this] { return mock->asked.contains("GetManagedObjects"); }));
    EXPECT_EQ(manager->trouble(), "");
    queue.advance(5s);
    EXPECT_EQ(manager->trouble(), "ModemManager does not answer");
    mock->wakeUp();
    ASSERT_TRUE(until([this] { return !phone().sim.iccid.empty(); }));  // late is better than never
    EXPECT_EQ(manager->trouble(), "");
}

TEST_F(ModemManagerTest, BelievesNoOwnerButTheOneItTrusts) {
    mock->addModem(0);
    follow("", ::getuid() + 1);
    ASSERT_TRUE(until([this] { return !manager->trouble().empty(); }));
    EXPECT_EQ(manager->trouble(), "the name of ModemManager on the bus belongs to user " + std::to_string(::getuid()) +
                                      ", not to user " + std::to_string(::getuid() + 1) + ": nothing is believed");
    EXPECT_EQ(lines("nothing is believed"), 1U);
    test::settle();
    EXPECT_TRUE(mock->asked.isEmpty());
}

TEST_F(ModemManagerTest, HearsNobodyWhoSpeaksInItsPlace) {
    followModem();
    MockManager impostor(bus.address(), "impostor");  // waits for the name, and signals meanwhile
    impostor.addModem(0);
    impostor.change(0, test::kModemInterface, {{"Model", "Impostor"}});
    impostor.changePart(MockManager::simPath(0), "org.freedesktop.ModemManager1.Sim", {{"SimIdentifier", "666"}});
    settle();
    EXPECT_EQ(phone().sim.iccid, "8900101000000123450");
}

TEST_F(ModemManagerTest, IsNotLedAstrayByValuesOfOtherTypes) {
    Interfaces& modem = mock->modems[0];
    modem[test::kModemInterface] = {{"Manufacturer", 1},      {"State", "registered"}, {"AccessTechnologies", -1.5},
                                    {"OwnNumbers", "number"}, {"Sim", "/sim"},         {"Bearers", QStringList{"/b"}},
                                    {"Ports", QStringList{}}, {"Model", "Odd"}};
    modem["org.freedesktop.ModemManager1.Modem.Signal"] = {{"Lte", "strong"}, {"Rate", "often"}};
    mock->cells = {{{"cell-type", "5"}, {"serving", 1}}};
    follow();
    ASSERT_TRUE(until([this] { return phone().model == "Odd"; }));
    EXPECT_EQ(phone().family, std::nullopt);
    EXPECT_EQ(phone().sim, phone::SimFiles{});
    EXPECT_EQ(phone().contexts, std::vector<phone::PdpContext>{});
    manager->measure(true);
    ASSERT_TRUE(until([this] { return phone().cells.has_value(); }));
    EXPECT_TRUE(phone().cells->empty());
}

TEST_F(ModemManagerTest, SaysThatThereIsNoBusAndTriesAgain) {
    int opened = 0;
    manager = std::make_unique<ModemManager>(
        [&] {
            ++opened;
            return QDBusConnection::connectToBus(opened == 1 ? "unix:path=/nonexistent/bus" : bus.address(),
                                                 "follower");
        },
        ::getuid(), "", queue);
    mock->addModem(0);
    manager->follow([] {});
    EXPECT_EQ(manager->trouble(), "there is no system bus");
    queue.advance(5s);
    EXPECT_TRUE(until([this] { return phone().modem == "0"; }));
}

TEST_F(ModemManagerTest, PutsNoIdentityOnTheLog) {
    mock->errors["GetCellInfo"] = kUnauthorized;
    followModem("860000000000000");
    manager->measure(true);
    ASSERT_TRUE(until([this] { return manager->lacks().size() == 1; }));
    mock->signalModem(0, false);
    ASSERT_TRUE(until([this] { return phone().modem.empty(); }));
    ASSERT_FALSE(log.lines().empty());
    for (const char* identity : {"8900101000000123450", "860000000000000", "+15550123", "123450", "secret"})
        EXPECT_EQ(lines(identity), 0U) << identity;
}

}  // namespace
}  // namespace kelvo::modemmanager
