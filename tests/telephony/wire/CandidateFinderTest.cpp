#include "telephony/wire/CandidateFinder.h"

#include <gtest/gtest.h>
#include <umockdev.h>

#include <memory>
#include <string>

namespace kelvo::wire {
namespace {

using Kind = CandidateNode::Kind;

/// A system with the devices of the test's own, and no others.
class CandidateFinderTest : public testing::Test {
protected:
    void SetUp() override {  // needs libumockdev-preload.so.0 in LD_PRELOAD
        _bed.reset(umockdev_testbed_new());
    }
    void add(const std::string& description) {
        GError* error = nullptr;
        ASSERT_TRUE(umockdev_testbed_add_from_string(_bed.get(), description.c_str(), &error)) << error->message;
    }
    void addModem() {
        add("P: /devices/usb1/1-1\nE: SUBSYSTEM=usb\nE: DEVTYPE=usb_device\n"
            "A: idVendor=1bad\nA: idProduct=0042\nA: product=LTE Stick\nA: serial=0815\n");
    }
    // A serial node of the modem: the interface's number and protocol, and how many of its end points are bulk ones.
    void addNode(const std::string& name, int interface, const std::string& protocol, int bulk,
                 const std::string& interfaceClass = "ff", const std::string& properties = "") {
        const std::string number = std::to_string(interface);
        const std::string path = "/devices/usb1/1-1/1-1:1." + number;
        std::string endpoints = "A: ep_83/type=Interrupt\n";
        for (int i = 0; i < bulk; ++i) endpoints += "A: ep_0" + std::to_string(i) + "/type=Bulk\n";
        add("P: " + path +
            "\nE: SUBSYSTEM=usb\nE: DEVTYPE=usb_interface\nL: driver=../../../../bus/usb/drivers/option\n" +
            "A: bInterfaceNumber=0" + number + "\nA: bInterfaceClass=" + interfaceClass +
            "\nA: bInterfaceSubClass=ff\nA: bInterfaceProtocol=" + protocol + "\n" + endpoints);
        add("P: " + path + "/" + name + "/tty/" + name + "\nN: " + name + "\nE: DEVNAME=/dev/" + name +
            "\nE: SUBSYSTEM=tty\n" + properties);
    }

private:
    struct Unref {
        void operator()(UMockdevTestbed* bed) const { g_object_unref(bed); }
    };
    std::unique_ptr<UMockdevTestbed, Unref> _bed;
};

}  // namespace

TEST_F(CandidateFinderTest, FindsNothingWhereNothingIs) { EXPECT_TRUE(findCandidates().empty()); }

TEST_F(CandidateFinderTest, TellsWhatANodeIs) {
    addModem();
    addNode("ttyUSB3", 2, "30", 2, "ff", "E: ID_MM_PORT_IGNORE=1\n");
    const auto nodes = findCandidates();
    ASSERT_EQ(nodes.size(), 1U);
    const CandidateNode& node = nodes.front();
    EXPECT_EQ(node.path, "/dev/ttyUSB3");
    EXPECT_EQ(node.driver, "option");
    EXPECT_EQ(node.kind, Kind::Diagnostic);
    EXPECT_TRUE(node.ignoredByModemManager);
    ASSERT_TRUE(node.usb);
    EXPECT_EQ(node.usb->vendor, 0x1bad);
    EXPECT_EQ(node.usb->product, 0x0042);
    EXPECT_EQ(node.usb->number, 2);
    EXPECT_EQ(node.usb->interfaceClass, 255);
    EXPECT_EQ(node.usb->subclass, 255);
    EXPECT_EQ(node.usb->protocol, 48);
    EXPECT_EQ(node.usb->bulkEndpoints, 2);
    EXPECT_EQ(node.usb->productName, "LTE Stick");
    EXPECT_EQ(node.usb->serial, "0815");
}

TEST_F(CandidateFinderTest, NamesTheLikeliestFirst) {
    addModem();
    addNode("ttyUSB0", 0, "ff", 2);
    addNode("ttyUSB1", 1, "00", 2);
    addNode("ttyUSB2", 2, "30", 1);
    addNode("ttyUSB3", 3, "30", 2);
    addNode("ttyACM0", 4, "01", 2, "02");
    std::vector<std::pair<std::string, Kind>> found;
    for (const auto& node : findCandidates()) found.emplace_back(node.path, node.kind);
    EXPECT_EQ(found, (std::vector<std::pair<std::string, Kind>>{{"/dev/ttyUSB3", Kind::Diagnostic},
                                                                {"/dev/ttyUSB0", Kind::Possible},
                                                                {"/dev/ttyUSB1", Kind::Other},
                                                                {"/dev/ttyUSB2", Kind::Other},
                                                                {"/dev/ttyACM0", Kind::Other}}));
}

TEST_F(CandidateFinderTest, LeavesOtherTerminalsOut) {
    add("P: /devices/virtual/tty/tty1\nN: tty1\nE: DEVNAME=/dev/tty1\nE: SUBSYSTEM=tty\n");
    add("P: /devices/platform/ttyHS0/tty/ttyHS0\nN: ttyHS0\nE: DEVNAME=/dev/ttyHS0\nE: SUBSYSTEM=tty\n");
    const auto nodes = findCandidates();
    ASSERT_EQ(nodes.size(), 1U);
    EXPECT_EQ(nodes.front().path, "/dev/ttyHS0");
    EXPECT_FALSE(nodes.front().usb);
    EXPECT_EQ(nodes.front().kind, Kind::Other);
}

}  // namespace kelvo::wire
