#pragma once

#include <optional>
#include <string>
#include <vector>

#include "platform/telephony/Technology.h"
#include "telephony/phone/PhonePayloads.h"

namespace kelvo::phone {

/// The levels of the LTE cell that serves, as far as they are told.
struct LteLevels {
    std::optional<double> rsrp = {};  ///< dBm
    std::optional<double> rsrq = {};  ///< dB
    std::optional<double> rssi = {};  ///< dBm

    bool operator==(const LteLevels&) const = default;
};

/// One of the ports that a modem is driven by.
struct DrivenPort {
    std::string name = {};      ///< "ttyUSB0"
    bool isDiagnostic = false;  ///< by its type; else an AT, network or other port

    bool operator==(const DrivenPort&) const = default;
};

/// What the phone's own services know of it. What they do not tell is empty or none, and stays so: nothing here is
/// guessed. Texts of identities are whole; whoever prints them shortens them.
struct PhoneState {
    std::string modem = {};         ///< its index; empty: there is none
    std::string model = {};         ///< maker and model
    std::string equipment = {};     ///< its identity
    std::string condition = {};     ///< "registered", "disabled"
    std::string registration = {};  ///< "home", "roaming"
    std::string network = {};       ///< the name of the network that serves
    std::string simOperator = {};   ///< as the SIM names it
    std::string access = {};        ///< "LTE", "GSM, EDGE"
    std::vector<DrivenPort> ports = {};

    std::optional<Technology> family = {};  ///< whose screens show it; none: registered nowhere, or 5G alone
    SimFiles sim = {};
    std::optional<std::vector<MonitoredCell>> cells = {};  ///< none: not told
    LteLevels lte = {};
    std::optional<std::vector<PdpContext>> contexts = {};  ///< none: not told

    bool operator==(const PhoneState&) const = default;
};

}  // namespace kelvo::phone
