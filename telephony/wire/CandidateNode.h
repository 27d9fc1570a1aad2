#pragma once

#include <cstdint>
#include <optional>
#include <string>

namespace kelvo::wire {

/// The USB interface behind a device node.
struct UsbInterface {
    std::uint16_t vendor = 0;
    std::uint16_t product = 0;
    std::uint8_t number = 0;          ///< of the interface
    std::uint8_t interfaceClass = 0;  ///< 255: the vendor's own
    std::uint8_t subclass = 0;
    std::uint8_t protocol = 0;
    int bulkEndpoints = 0;
    std::string productName;  ///< as the device words it; may be empty
    std::string serial;       ///< may be empty
};

/// A device node that may be a modem's diagnostic port: one of several serial nodes that a modem has.
struct CandidateNode {
    enum class Kind {
        Diagnostic,  ///< class 255, subclass 255, protocol 48, two bulk end points
        Possible,    ///< class 255, subclass 255, protocol 255, two bulk end points
        Other,       ///< any other: for AT commands, positioning, …
    };

    std::string path;                 ///< "/dev/ttyUSB0"
    std::optional<UsbInterface> usb;  ///< none: it is not on USB
    std::string driver;               ///< of the interface: "option"; may be empty
    Kind kind = Kind::Other;
    bool ignoredByModemManager = false;  ///< a udev rule tells the modem manager to leave it alone
};

/// What an interface makes of its node.
CandidateNode::Kind kindOf(const UsbInterface& usb);

}  // namespace kelvo::wire
