#include "telephony/ServiceConfig.h"

#include <gtest/gtest.h>

#include "telephony/ServiceOptions.h"
#include "tests/support/CapturedOutput.h"
#include "tests/support/TemporaryDirectory.h"

namespace kelvo {
namespace {

class ServiceConfigTest : public testing::Test {
protected:
    struct Parsed {
        ParsedOptions parsed;
        std::string output;
        std::string errors;
    };
    Parsed parse(std::vector<const char*> arguments) {
        arguments.insert(arguments.begin(), "kelvo-telephonyd");
        testing::internal::CaptureStdout();
        testing::internal::CaptureStderr();
        auto parsed = parseServiceOptions(static_cast<int>(arguments.size()), arguments.data(), _places);
        return {std::move(parsed), testing::internal::GetCapturedStdout(), testing::internal::GetCapturedStderr()};
    }
    /// What it starts with, which it must.
    ServiceOptions options(std::vector<const char*> arguments = {}) {
        Parsed result = parse(std::move(arguments));
        EXPECT_TRUE(result.parsed.options) << result.errors;
        return result.parsed.options.value_or(ServiceOptions());
    }
    void expectRefusal(const std::string& text, const std::string& reason) {
        const std::string path = _temporary.write("system.conf", bytesOf(text));
        const Parsed result = parse({});
        EXPECT_FALSE(result.parsed.options) << text;
        EXPECT_EQ(result.parsed.exitStatus, 1);
        EXPECT_EQ(result.errors, "kelvo-telephonyd: " + path + ": " + reason + "\n");
        EXPECT_EQ(result.output, "");
    }

    test::TemporaryDirectory _temporary;
    ConfigPlaces _places{_temporary.path() / "user.conf", _temporary.path() / "system.conf"};
};

TEST_F(ServiceConfigTest, SaysWhatToStartWithByTheOptionsNames) {
    _temporary.write("system.conf", bytesOf("# the modem in the slot\n"
                                            "port = \"/dev/ttyUSB0\"\n"
                                            "technology = \"gsm\"\n"
                                            "\n"
                                            "subscription = 2\n"
                                            "no-dtr-rts = true\n"
                                            "allow-remote = false\n"
                                            "modemmanager = \"1\"\n"
                                            "record = \"/srv/log, with blanks.pcap\"\n"
                                            "force = true\n"));
    const ServiceOptions read = options();
    ASSERT_TRUE(read.port);
    EXPECT_EQ(std::get<PortAddress::Node>(read.port->place).path, "/dev/ttyUSB0");
    EXPECT_EQ(read.session.technology, Technology::GSM);
    EXPECT_EQ(read.session.subscription, 2);
    EXPECT_FALSE(read.line.controlLines);
    EXPECT_EQ(read.modemManager, "1");
    EXPECT_EQ(read.record, "/srv/log, with blanks.pcap");
    EXPECT_TRUE(read.force);
}

TEST_F(ServiceConfigTest, TakesAnOptionWithoutItsValue) {
    for (const char* text : {"modemmanager = true\n", "modemmanager = \"\"\n"}) {
        _temporary.write("system.conf", bytesOf(text));
        EXPECT_EQ(options().modemManager, "") << text;
    }
    _temporary.write("system.conf", bytesOf("modemmanager = false\nport = \"auto\"\n"));
    EXPECT_FALSE(options().modemManager);
}

TEST_F(ServiceConfigTest, OfTheUserGoesBeforeTheSystems) {
    _temporary.write("system.conf", bytesOf("simulate = \"gsm\"\nspeed = 3\n"));
    _temporary.write("user.conf", bytesOf("simulate = \"cdma\"\n"));
    const ServiceOptions read = options();
    EXPECT_EQ(read.simulate, Technology::CDMA);
    EXPECT_EQ(read.speed, 1.0);  // of the system's file nothing counts
    const std::string named = _temporary.write("named.conf", bytesOf("simulate = \"utran\"\n"));
    EXPECT_EQ(options({"--config", named.c_str()}).simulate, Technology::UTRAN);
    EXPECT_EQ(options({("--config=" + named).c_str()}).simulate, Technology::UTRAN);
}

TEST_F(ServiceConfigTest, GivesWayToTheCommandLine) {
    _temporary.write("system.conf", bytesOf("simulate = \"gsm\"\nspeed = 3\nseed = 7\n"));
    const ServiceOptions read = options({"--speed", "5"});
    EXPECT_EQ(read.simulate, Technology::GSM);
    EXPECT_EQ(read.speed, 5.0);
    EXPECT_EQ(read.seed, 7U);
    EXPECT_EQ(options({"--speed=max"}).speed, std::nullopt);
}

TEST_F(ServiceConfigTest, IsNotReadWhereTheCommandLineNamesASource) {
    _temporary.write("system.conf", bytesOf("nonsense\n"));
    EXPECT_EQ(options({"--simulate", "lte"}).seed, 1U);
    EXPECT_TRUE(options({"--port=auto"}).port);
    EXPECT_TRUE(options({"--status"}).status);
    EXPECT_EQ(parse({"--version"}).parsed.exitStatus, 0);
    EXPECT_EQ(parse({"--port", "auto", "--check-config"}).errors,
              "kelvo-telephonyd: a configuration is read where the command line names no source\n");
}

TEST_F(ServiceConfigTest, ThatIsWrongIsToldInOneLine) {
    expectRefusal("prot = \"auto\"\n", "there is no option prot");
    expectRefusal("port \"auto\"\n", "there is no option port \"auto\"");
    expectRefusal("[service]\nport = \"auto\"\n", "there is no section service");
    expectRefusal("port = \"auto\"\nport = \"/dev/ttyUSB0\"\n", "port has no value, or several");
    expectRefusal("port = [\"auto\", \"other\"]\n", "port has no value, or several");
    expectRefusal("port = \"\"\n", "port has no value");
    expectRefusal("port = \"/dev/tty#1\"\n", "port: its text does not end (# begins a comment)");
    expectRefusal("port = \"auto\"\nno-dtr-rts = maybe\n", "no-dtr-rts is true or false, not maybe");
    expectRefusal("port = \"auto\"\nsubscription = 0\n", "--subscription: 0 is no number from 1 to 255");
    expectRefusal("simulate = \"nmt\"\n", "--simulate: nmt is none of ifx, gsm, cdma, lte, utran");
    expectRefusal("simulate = \"lte\"\nport = \"auto\"\n", "--simulate excludes --port");
    expectRefusal("status = true\n", "status is for the command line");
    expectRefusal("config = \"other\"\n", "config is for the command line");
    expectRefusal("# nothing\n", "it names no source: replay, simulate, port or modemmanager");
    expectRefusal("", "it names no source: replay, simulate, port or modemmanager");
    expectRefusal(std::string(70'000, '#'), "it is longer than 65536 bytes");
}

TEST_F(ServiceConfigTest, ThatIsNowhereIsToldInOneLine) {
    const std::string user = _places.user;
    EXPECT_EQ(parse({}).errors, "kelvo-telephonyd: it needs a source (--help tells which), or a configuration: " +
                                    user + " or " + _places.system.string() + "\n");
    EXPECT_EQ(parse({"--config", user.c_str()}).errors, "kelvo-telephonyd: " + user + ": it cannot be read\n");
    EXPECT_EQ(parse({"--config", _temporary.path().c_str()}).errors,
              "kelvo-telephonyd: " + _temporary.path().string() + ": it is a directory\n");
}

TEST_F(ServiceConfigTest, IsCheckedWithoutAService) {
    const std::string path = _temporary.write("user.conf", bytesOf("port = \"auto\"\nmodemmanager = true\n"));
    const Parsed right = parse({"--check-config"});
    EXPECT_FALSE(right.parsed.options);
    EXPECT_EQ(right.parsed.exitStatus, 0);
    EXPECT_EQ(right.output, path + " is in order\n");
    const std::string wrong = _temporary.write("wrong.conf", bytesOf("port = \"unix:\"\n"));
    const Parsed refused = parse({"--check-config", "--config", wrong.c_str()});
    EXPECT_EQ(refused.parsed.exitStatus, 1);
    EXPECT_EQ(refused.errors, "kelvo-telephonyd: " + wrong + ": --port: unix: lacks its path\n");
}

TEST_F(ServiceConfigTest, ThatIsInstalledIsInOrder) {
    const Parsed checked = parse({"--check-config", "--config", KELVO_INSTALLED_CONFIG});
    EXPECT_EQ(checked.parsed.exitStatus, 0) << checked.errors;
    const ServiceOptions read = options({"--config", KELVO_INSTALLED_CONFIG});
    ASSERT_TRUE(read.port);
    EXPECT_TRUE(std::holds_alternative<PortAddress::Automatic>(read.port->place));
    EXPECT_EQ(read.modemManager, "");
}

TEST(ConfigPlacesTest, AreTheUsersAndTheSystems) {
    const test::TemporaryDirectory home;
    ::setenv("XDG_CONFIG_HOME", home.path().c_str(), 1);
    const ConfigPlaces places = ConfigPlaces::ofHost();
    ::unsetenv("XDG_CONFIG_HOME");
    EXPECT_EQ(places.user, home.path() / "kelvo/telephonyd.conf");
    EXPECT_EQ(places.system, "/etc/kelvo/telephonyd.conf");
}

}  // namespace
}  // namespace kelvo
