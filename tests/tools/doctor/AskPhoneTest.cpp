#include "tools/doctor/AskPhone.h"

#include <gtest/gtest.h>
#include <unistd.h>

#include "tests/support/PrivateBus.h"
#include "tests/telephony/modemmanager/MockManager.h"

namespace kelvo {
namespace {

using test::MockManager;

class AskPhoneTest : public testing::Test {
protected:
    void SetUp() override {
        if (!bus) GTEST_SKIP() << "no bus is installed";
        mock = std::make_unique<MockManager>(bus.address());
    }
    PhoneFindings ask() {
        return askPhone([this](const QString& name) { return QDBusConnection::connectToBus(bus.address(), name); },
                        ::getuid());
    }

    test::PrivateBus bus;
    std::unique_ptr<MockManager> mock;
};

TEST_F(AskPhoneTest, AsksEveryModemForSimCellsAndContexts) {
    for (const int index : {0, 1, 10}) mock->addModem(index);
    mock->cells = {{{"cell-type", 5U}, {"serving", true}, {"physical-ci", "12D"}, {"earfcn", 1300U}}};
    const PhoneFindings findings = ask();
    EXPECT_EQ(findings.trouble, "");
    ASSERT_EQ(findings.modems.size(), 3U);
    EXPECT_EQ(findings.modems[0].phone.modem, "0");
    EXPECT_EQ(findings.modems[0].phone.sim.iccid, "8900101000000123450");
    EXPECT_EQ(findings.modems[1].phone.modem, "1");
    EXPECT_EQ(findings.modems[1].phone.sim.iccid, "8900101000000123451");
    EXPECT_EQ(findings.modems[2].phone.modem, "10");
    EXPECT_EQ(findings.modems[2].phone.sim.iccid, "89001010000001234510");
    for (const ModemFindings& modem : findings.modems) {
        ASSERT_TRUE(modem.phone.cells);
        EXPECT_EQ(modem.phone.cells->size(), 1U);
        ASSERT_TRUE(modem.phone.contexts);
        EXPECT_EQ(modem.phone.contexts->size(), 1U);
    }
    EXPECT_TRUE(mock->rates.isEmpty());
}

TEST_F(AskPhoneTest, TellsOfEachModemWhatItLacks) {
    for (const int index : {0, 1}) mock->addModem(index);
    mock->errors["GetCellInfo"] = "org.freedesktop.ModemManager1.Error.Core.Failed";
    const PhoneFindings findings = ask();
    ASSERT_EQ(findings.modems.size(), 2U);
    for (const ModemFindings& modem : findings.modems) {
        EXPECT_EQ(modem.lacks, std::vector<std::string>{"cell information: it says no"});
        EXPECT_FALSE(modem.phone.sim.iccid.empty());
    }
}

TEST_F(AskPhoneTest, SaysThatThereIsNoModem) {
    const PhoneFindings findings = ask();
    EXPECT_EQ(findings.trouble, "ModemManager has no modem");
    EXPECT_TRUE(findings.modems.empty());
}

}  // namespace
}  // namespace kelvo
