#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "overview/Screens.h"
#include "platform/telephony/Technology.h"

namespace kelvo::overview {

/// A named text: {"Band", "3 (1,805 MHz down, 1,710 MHz up)"}.
struct Fact {
    std::string name;
    std::string text;
    std::optional<Figure> figure{};  ///< of a rate: the number behind the text, where it is one
    bool operator==(const Fact& other) const { return name == other.name && text == other.text; }
};

/// A level or a quality, with what people call it here.
struct Measure {
    std::string name;  ///< "RSRP"
    Figure figure;
    std::string grade;  ///< "good"; empty where no grades are agreed on
};

/// A cell beside the serving one, as one list of the screens has it.
struct HeardCell {
    std::string identity;  ///< "EARFCN 1300, PCI 257": says which cell it is, wherever it stands in the list
    std::string mark;      ///< "active", "candidate", "detected"; empty for an ordinary neighbor
    std::optional<Measure> level;
    std::optional<Measure> quality;
    std::uint64_t record = 0;  ///< which told of it last
};

/// A data context: a bearer of the phone's own traffic.
struct Context {
    std::string name;  ///< its APN and number: "internet (5)"
    std::string text;  ///< state, type and address
    bool isUp = false;
};

/// What the screens say at one moment, in the words of the overview. Whatever they do not say is empty.
struct Observation {
    std::string access;         ///< which radio the phone is on: "LTE", "GSM", "UMTS", "CDMA2000 1x"
    std::string state;          ///< "idle", "connected", "Cell DCH", "traffic"
    bool isDedicated = false;   ///< connected: a change of cell is a handover
    bool knowsService = false;  ///< the screens tell whether there is service
    bool isWithoutService = false;
    std::string cell;                 ///< the serving cell's identity as in `HeardCell`
    std::uint64_t cellRecord = 0;     ///< which told that it serves
    std::string channel;              ///< the part of it that names the carrier
    bool cellIsOneOfSeveral = false;  ///< of several carriers each is told as serving, and this one was told last
    bool cellComesInParts = false;    ///< records tell carrier and code apart, so that one may be new and one old
    std::string band;
    std::string area;           ///< "TAC 1042"
    std::vector<Fact> serving;  ///< what else is known of the serving cell
    std::optional<Measure> level;
    std::optional<Measure> quality;
    std::vector<HeardCell> cells;  ///< in the screens' order
    std::vector<Fact> registration;
    std::string registrationState;  ///< the one of them whose changes matter
    std::string reject;             ///< why the network refused the phone last; empty when it did not
    std::vector<Context> contexts;
    std::vector<Fact> rates;  ///< throughput and error rates
};

/// Works a display out. One function knows one family; they hold its rules and nothing else does.
Observation observe(Technology technology, const Value& display);

}  // namespace kelvo::overview
