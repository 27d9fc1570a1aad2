#include "telephony/wire/CandidateFinder.h"

#include <libudev.h>

#include <algorithm>
#include <charconv>
#include <filesystem>
#include <fstream>
#include <memory>
#include <string_view>
#include <tuple>

namespace kelvo::wire {
namespace {

template <auto unref>
struct Unref {
    void operator()(auto* object) const { unref(object); }
};
using Udev = std::unique_ptr<udev, Unref<udev_unref>>;
using Enumerate = std::unique_ptr<udev_enumerate, Unref<udev_enumerate_unref>>;
using Device = std::unique_ptr<udev_device, Unref<udev_device_unref>>;

std::string textOf(const char* text) { return text != nullptr ? text : ""; }

std::string attribute(udev_device* device, const char* name) {
    return textOf(udev_device_get_sysattr_value(device, name));
}

// A number of four or two hexadecimal digits, as USB's attributes are; 0 when it is none.
template <class Number>
Number hexadecimal(udev_device* device, const char* name) {
    const std::string text = attribute(device, name);
    Number number = 0;
    std::from_chars(text.data(), text.data() + text.size(), number, 16);
    return number;
}

// End points are directories below their interface, not devices of their own.
int bulkEndpointsBelow(const std::filesystem::path& interface) {
    std::error_code error;
    int count = 0;
    for (const auto& entry : std::filesystem::directory_iterator(interface, error)) {
        if (!entry.path().filename().string().starts_with("ep_")) continue;
        std::string type;
        std::ifstream(entry.path() / "type") >> type;
        if (type == "Bulk") ++count;
    }
    return count;
}

std::optional<UsbInterface> usbBehind(udev_device* node) {
    udev_device* const interface = udev_device_get_parent_with_subsystem_devtype(node, "usb", "usb_interface");
    udev_device* const device = udev_device_get_parent_with_subsystem_devtype(node, "usb", "usb_device");
    if (interface == nullptr || device == nullptr) return std::nullopt;
    UsbInterface usb;
    usb.vendor = hexadecimal<std::uint16_t>(device, "idVendor");
    usb.product = hexadecimal<std::uint16_t>(device, "idProduct");
    usb.number = hexadecimal<std::uint8_t>(interface, "bInterfaceNumber");
    usb.interfaceClass = hexadecimal<std::uint8_t>(interface, "bInterfaceClass");
    usb.subclass = hexadecimal<std::uint8_t>(interface, "bInterfaceSubClass");
    usb.protocol = hexadecimal<std::uint8_t>(interface, "bInterfaceProtocol");
    usb.bulkEndpoints = bulkEndpointsBelow(udev_device_get_syspath(interface));
    usb.productName = attribute(device, "product");
    usb.serial = attribute(device, "serial");
    return usb;
}

std::string driverBehind(udev_device* node) {
    udev_device* const interface = udev_device_get_parent_with_subsystem_devtype(node, "usb", "usb_interface");
    udev_device* const parent = interface != nullptr ? interface : udev_device_get_parent(node);
    return parent != nullptr ? textOf(udev_device_get_driver(parent)) : std::string();
}

std::optional<CandidateNode> describe(udev_device* device) {
    const char* const path = udev_device_get_devnode(device);
    if (path == nullptr) return std::nullopt;
    CandidateNode node;
    node.path = path;
    node.usb = usbBehind(device);
    node.driver = driverBehind(device);
    if (node.usb) node.kind = kindOf(*node.usb);
    node.ignoredByModemManager = textOf(udev_device_get_property_value(device, "ID_MM_PORT_IGNORE")) == "1";
    return node;
}

auto order(const CandidateNode& node) {
    const UsbInterface usb = node.usb.value_or(UsbInterface{});
    return std::tuple(node.kind, usb.vendor, usb.product, usb.serial, usb.number, node.path);
}

}  // namespace

CandidateNode::Kind kindOf(const UsbInterface& usb) {
    if (usb.interfaceClass != 255 || usb.subclass != 255 || usb.bulkEndpoints != 2) return CandidateNode::Kind::Other;
    if (usb.protocol == 48) return CandidateNode::Kind::Diagnostic;
    return usb.protocol == 255 ? CandidateNode::Kind::Possible : CandidateNode::Kind::Other;
}

std::vector<CandidateNode> findCandidates() {
    const Udev library(udev_new());
    const Enumerate search(library ? udev_enumerate_new(library.get()) : nullptr);
    if (!search) return {};
    udev_enumerate_add_match_subsystem(search.get(), "tty");
    for (const char* name : {"ttyUSB*", "ttyACM*", "ttyHS*"}) udev_enumerate_add_match_sysname(search.get(), name);
    udev_enumerate_scan_devices(search.get());
    std::vector<CandidateNode> nodes;
    udev_list_entry* entry = nullptr;
    udev_list_entry_foreach(entry, udev_enumerate_get_list_entry(search.get())) {
        const Device device(udev_device_new_from_syspath(library.get(), udev_list_entry_get_name(entry)));
        auto node = device ? describe(device.get()) : std::nullopt;
        if (node) nodes.push_back(std::move(*node));
    }
    std::ranges::sort(nodes, {}, order);
    return nodes;
}

}  // namespace kelvo::wire
