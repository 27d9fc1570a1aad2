#include "tools/doctor/Doctor.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <map>

#include "tests/support/TemporaryDirectory.h"

namespace kelvo {
namespace {

using Kind = wire::CandidateNode::Kind;

/// A system that the test makes up.
class DoctorTest : public testing::Test {
protected:
    static wire::CandidateNode node(const std::string& path, Kind kind = Kind::Diagnostic) {
        wire::UsbInterface usb;
        usb.vendor = 0x1bad;
        usb.product = 0x0042;
        usb.number = 2;
        usb.interfaceClass = usb.subclass = 255;
        usb.protocol = kind == Kind::Diagnostic ? 48 : 255;
        usb.bulkEndpoints = 2;
        usb.productName = "LTE Stick";
        return {.path = path, .usb = usb, .driver = "option", .kind = kind};
    }
    void add(const std::string& path, Kind kind = Kind::Diagnostic) {
        candidates.push_back(node(path, kind));
        access[path] = {.exists = true, .mayOpen = true, .group = "dialout"};
    }
    Findings look(std::optional<std::string> place = {}, bool probe = false) {
        return examine({.candidates = [this] { return candidates; },
                        .access = [this](const std::string& path) { return access[path]; },
                        .holders = [this](const std::string& path) { return holders[path]; },
                        .modemManagerRuns = [this] { return managerRuns; },
                        .phone = [this] { return phone; },
                        .probe =
                            [this](const std::string& path) {
                                probed.push_back(path);
                                return probes[path];
                            },
                        .user = "ada"},
                       place, probe);
    }
    std::string next(std::optional<std::string> place = {}, bool probe = false) { return nextStep(look(place, probe)); }

    std::vector<wire::CandidateNode> candidates;
    std::map<std::string, PortAccess> access;
    std::map<std::string, PortHolders> holders;
    std::map<std::string, ModemProbe> probes;
    std::vector<std::string> probed;
    bool managerRuns = false;
    PhoneFindings phone;
};

TEST_F(DoctorTest, SaysWhatToDoWhereThereIsNothing) {
    EXPECT_EQ(findingsText(look()),
              "There is no serial port that a modem may be behind.\n"
              "\n"
              "Next: plug a modem in and run this again, or name its port: run \"kelvoctl doctor --port "
              "PATH|tcp:HOST:PORT|unix:PATH\"\n");
}

TEST_F(DoctorTest, TellsEverythingOfAPort) {
    add("/dev/ttyUSB2");
    holders["/dev/ttyUSB2"] = {.known = {{812, "ModemManager"}}, .someHidden = true};
    managerRuns = true;
    EXPECT_EQ(findingsText(look()),
              "/dev/ttyUSB2: a diagnostic port, by its interface\n"
              "  USB            1bad:0042 \"LTE Stick\", interface 2 (255/255/48, 2 bulk end points), driver option\n"
              "  permission     this user may open it\n"
              "  open in        ModemManager (812), as far as this user can see\n"
              "  modem manager  runs, and may take it\n"
              "\n"
              "Next: run \"kelvoctl doctor --port /dev/ttyUSB2 --udev-rule | sudo tee "
              "/etc/udev/rules.d/78-kelvo-modem.rules\", and plug the modem in again\n");
}

TEST_F(DoctorTest, TellsWhatModemManagerKnowsAndWhichScreensThatFills) {
    managerRuns = true;
    phone::PhoneState modem;
    modem.modem = "0";
    modem.model = "Maker Model";
    modem.equipment = "860000000000012";
    modem.condition = "registered";
    modem.access = "LTE";
    modem.network = "Test Network";
    modem.registration = "home";
    modem.family = Technology::LTE;
    modem.ports = {{.name = "ttyUSB1"}, {.name = "cdc-wdm0"}};
    modem.sim.iccid = "8900101000000123456";
    modem.cells = {
        {.technology = phone::MonitoredCell::Technology::LTE, .isServing = true, .pid = 301, .uarfcn = 1300}};
    modem.contexts.emplace();
    phone::PhoneState other{.modem = "1", .model = "Other", .condition = "disabled"};
    other.sim.iccid = "8900101000000654321";
    phone.modems = {{modem, {"signal values: it says no"}}, {other, {"cell information: it is off"}}};
    EXPECT_EQ(findingsText(look()),
              "There is no serial port that a modem may be behind.\n"
              "\n"
              "ModemManager's modem 0: Maker Model\n"
              "  it is          registered, on LTE\n"
              "  network        Test Network, home\n"
              "  has the ports  ttyUSB1, cdc-wdm0\n"
              "  knows          SIM …3456, cells: 1, data contexts: 0\n"
              "  lacks          signal values: it says no\n"
              "  LTE screens    PDP Context Info, SIM Info, Serving Cell Measurements; in part Serving Cell Info\n"
              "ModemManager's modem 1: Other\n"
              "  it is          disabled\n"
              "  knows          SIM …4321\n"
              "  lacks          cell information: it is off\n"
              "\n"
              "Next: run \"kelvo-telephonyd --modemmanager\", and then kelvo\n");
    phone.modems[0].phone.cells->front().pid.reset();  // no way to say whose levels they are
    EXPECT_NE(findingsText(look()).find("  LTE screens    PDP Context Info, SIM Info; in part Serving Cell Info\n"),
              std::string::npos);
    const auto json = findingsJson(look())["modemManager"];
    EXPECT_EQ(json["modems"][0]["sim"], "…3456");
    EXPECT_EQ(json["modems"][0]["screens"]["technology"], "LTE");
    EXPECT_EQ(json["modems"][1]["sim"], "…4321");
    EXPECT_EQ(json["modems"][1]["lacks"], std::vector<std::string>{"cell information: it is off"});
    EXPECT_EQ(json["lacks"], std::vector<std::string>{"signal values: it says no"});  // of the first
    EXPECT_EQ(json.dump().find("8600"), std::string::npos);
}

TEST_F(DoctorTest, SaysWhyModemManagerKnowsNothing) {
    managerRuns = true;
    phone.trouble = "ModemManager has no modem";
    EXPECT_NE(findingsText(look()).find(
                  "\nModemManager\n  trouble        ModemManager has no modem\n\nNext: plug a modem in"),
              std::string::npos);
}

TEST_F(DoctorTest, TellsWhatAModemAnswersAndWhichScreensItFills) {
    add("/dev/ttyUSB0");
    wire::Ranges ranges{};
    ranges[1] = 0x1000;
    ranges[0xD] = 0xE2;
    probes["/dev/ttyUSB0"] = {.target = "T9\x1b[2J", .buildId = "B7", .ranges = ranges, .isStreaming = true};
    const std::string text = findingsText(look({}, true));
    EXPECT_NE(text.find("  asked          it is \"T9\uFFFD[2J\", build \"B7\", and streams records already\n"
                        "  ranges         1: 0x1000, 13: 0xe2\n"),
              std::string::npos)
        << text;
    EXPECT_NE(text.find("  CDMA screens   all 8\n"), std::string::npos) << text;
    EXPECT_NE(text.find("  LTE screens    0 of 9; not "), std::string::npos) << text;
    EXPECT_NE(text.find("\nNext: run \"kelvo-telephonyd --port /dev/ttyUSB0\", and then kelvo\n"), std::string::npos);
}

TEST_F(DoctorTest, AsksOnlyPortsThatAreFreeAndMayBeDiagnosticOnes) {
    add("/dev/ttyUSB0");
    add("/dev/ttyUSB1");
    add("/dev/ttyUSB2", Kind::Possible);
    add("/dev/ttyUSB3", Kind::Other);
    add("/dev/ttyUSB4");
    holders["/dev/ttyUSB0"].known = {{5, "reader"}};
    access["/dev/ttyUSB1"].mayOpen = false;
    look({}, true);
    EXPECT_EQ(probed, (std::vector<std::string>{"/dev/ttyUSB2", "/dev/ttyUSB4"}));
    probed.clear();
    look("/dev/ttyUSB3", true);  // whoever names a port wants it asked
    EXPECT_EQ(probed, (std::vector<std::string>{"/dev/ttyUSB3"}));
    probed.clear();
    look("auto");
    EXPECT_TRUE(probed.empty());
}

TEST_F(DoctorTest, KnowsACandidateByALinkToIt) {
    const test::TemporaryDirectory directory;
    const std::string device = directory.write("ttyUSB5", {});
    const std::string link = directory.file("modem");
    std::filesystem::create_symlink(device, link);
    add(std::filesystem::canonical(device));
    const Findings findings = look(link);
    ASSERT_EQ(findings.ports.size(), 1U);
    EXPECT_EQ(findings.ports[0].node.path, link);
    EXPECT_EQ(findings.ports[0].node.kind, Kind::Diagnostic);
}

TEST_F(DoctorTest, LooksForNoFileBehindANetworkPort) {
    probes["tcp:10.0.0.1:5555"] = {.failure = "does not answer: not a diagnostic port, or in use"};
    EXPECT_EQ(findingsText(look("tcp:10.0.0.1:5555", true)),
              "tcp:10.0.0.1:5555: a network port\n"
              "  asked          does not answer: not a diagnostic port, or in use\n"
              "\n"
              "Next: see what listens on tcp:10.0.0.1:5555: it is no diagnostic port\n");
}

TEST_F(DoctorTest, EndsWithTheOneThingThatIsInTheWay) {
    add("/dev/ttyUSB0");
    EXPECT_EQ(next(), "run \"kelvoctl doctor --port /dev/ttyUSB0 --probe\", which asks it what it can show");
    managerRuns = true;
    EXPECT_EQ(next().substr(0, 63), "run \"kelvoctl doctor --port /dev/ttyUSB0 --udev-rule | sudo tee");
    candidates[0].ignoredByModemManager = true;
    EXPECT_EQ(next(), "run \"kelvoctl doctor --port /dev/ttyUSB0 --probe\", which asks it what it can show");
    holders["/dev/ttyUSB0"].known = {{77, "minicom"}};
    EXPECT_EQ(next(), "end minicom (process 77), which has /dev/ttyUSB0 open");
    holders["/dev/ttyUSB0"].known = {{78, "kelvo-telephonyd"}};
    EXPECT_EQ(next(), "run kelvo: its telephony service has /dev/ttyUSB0 already");
    access["/dev/ttyUSB0"].mayOpen = false;
    EXPECT_EQ(next(), "add yourself to the group dialout: run \"sudo usermod -aG dialout ada\", and log in again");
    access["/dev/ttyUSB0"].group = "";
    EXPECT_EQ(next().substr(0, 63), "run \"kelvoctl doctor --port /dev/ttyUSB0 --udev-rule | sudo tee");
    access["/dev/ttyUSB0"].exists = false;
    EXPECT_EQ(next(), "plug the modem in: /dev/ttyUSB0 is not there");
}

TEST_F(DoctorTest, PrefersThePortThatAnswers) {
    add("/dev/ttyUSB0");
    add("/dev/ttyUSB1");
    probes["/dev/ttyUSB0"] = {.failure = "does not answer: not a diagnostic port, or in use"};
    EXPECT_EQ(next({}, true), "run \"kelvo-telephonyd --port /dev/ttyUSB1\", and then kelvo");
}

TEST_F(DoctorTest, SendsOnFromAPortThatDoesNotAnswer) {
    add("/dev/ttyUSB0");
    probes["/dev/ttyUSB0"] = {.failure = "does not answer: not a diagnostic port, or in use"};
    EXPECT_EQ(next({}, true), "try another port of the modem than /dev/ttyUSB0, or plug it in again");
}

TEST_F(DoctorTest, TellsProgramsTheSame) {
    add("/dev/ttyUSB2");
    holders["/dev/ttyUSB2"].known = {{812, "ModemManager"}};
    const nlohmann::ordered_json json = findingsJson(look());
    const nlohmann::ordered_json& port = json["ports"][0];
    EXPECT_EQ(port["port"], "/dev/ttyUSB2");
    EXPECT_EQ(port["kind"], "diagnostic");
    EXPECT_EQ(port["usb"]["vendor"], "1bad");
    EXPECT_EQ(port["usb"]["protocol"], 48);
    EXPECT_EQ(port["mayOpen"], true);
    EXPECT_EQ(port["openIn"], nlohmann::ordered_json::parse(R"([{"process": 812, "name": "ModemManager"}])"));
    EXPECT_FALSE(port.contains("probe"));
    EXPECT_EQ(json["modemManagerRuns"], false);
    EXPECT_EQ(json["next"], next());
}

TEST_F(DoctorTest, TellsProgramsWhatWasAnswered) {
    add("/dev/ttyUSB2");
    wire::Ranges ranges{};
    ranges[1] = 0x34F;
    probes["/dev/ttyUSB2"] = {.target = "T9", .buildId = "B7", .ranges = ranges};
    const nlohmann::ordered_json probe = findingsJson(look({}, true))["ports"][0]["probe"];
    EXPECT_EQ(probe["target"], "T9");
    EXPECT_EQ(probe["ranges"][1], 0x34F);
    EXPECT_EQ(probe["screens"]["CDMA"]["empty"], (std::vector<std::string>{"System Identification"}));
}

TEST(UdevRule, KnowsTheInterfaceOfTheModemAndKeepsTheModemManagerAway) {
    wire::UsbInterface usb;
    usb.vendor = 0x1bad;
    usb.product = 0x42;
    usb.number = 11;
    EXPECT_EQ(
        udevRule({.path = "/dev/ttyUSB0", .usb = usb, .driver = "option"}),
        "# The diagnostic port of the modem 1bad:0042, interface 11, for Kelvo: gives it to the group dialout, and\n"
        "# tells the modem manager to leave it alone.\n"
        "ACTION!=\"remove\", SUBSYSTEM==\"tty\", ENV{ID_VENDOR_ID}==\"1bad\", ENV{ID_MODEL_ID}==\"0042\", "
        "ENV{ID_USB_INTERFACE_NUM}==\"0b\", GROUP=\"dialout\", MODE=\"0660\", ENV{ID_MM_PORT_IGNORE}=\"1\"\n");
}

}  // namespace
}  // namespace kelvo
