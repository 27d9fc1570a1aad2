#pragma once

#include <string>
#include <vector>

#include "LogGenerator/CDMA/C2KLogGenerator.h"
#include "platform/system/Environment.h"
#include "tests/support/Record.h"
#include "tests/support/RecordingLog.h"

namespace kelvo::test {

/// A CDMA generator whose every lookup key is bound to a place of its own, under the key's own name, in one flat
/// display; what it shows, keeps and logs can be read back.
class C2KScreen {
public:
    C2KScreen() {
        for (const char* key :
             {"kFingerC2I",       "kChannel",        "k1xEVDODeviceState", "kBandClass",       "kRxAGC0",
              "kRxAGC1",          "kTxAGC",          "kServingPNOffset",   "kSessionState",    "kUATI24",
              "kColorCode",       "kFLDataRate",     "k1xDeviceState",     "k1xRx0BandClass",  "k1xRx0ChanNum",
              "k1xRxAGC0",        "k1xRx1BandClass", "k1xRx1ChanNum",      "k1xRxAGC1",        "k1xTxAGC",
              "k1xActiveSetInfo", "k1xTrafficFER",   "kRLDataRate",        "kActiveSetPilots", "k1xRoamingHome",
              "kSystemId",        "kNetworkId",      "kPacketZoneId",      "kBaseId",          "kProtocolRevision"}) {
            lookup->set(key, Array::make({Dictionary::make({{"key", key}, {"dict", display}})}));
        }
        state.set("ExtraInfo", Dictionary::make());
    }
    explicit C2KScreen(const Record& record) : C2KScreen() { feed(record); }

    C2KScreen& feed(const Record& record) { return feed(record.bytes()); }
    C2KScreen& feed(const Bytes& message) {
        const Environment::Scope environment({.log = &_log});
        generator.updateFromLog(message, lookup, state);
        return *this;
    }

    /// The text shown for a lookup key; "(absent)" when there is none, "(no text)" for a list.
    std::string operator[](const char* key) const { return textOf(*display, key); }
    /// The list of pilots shown for a lookup key; null when there is none.
    DictionaryRef list(const char* key) const { return (*display)[key].dictionary(); }
    /// The text of one row in such a list.
    std::string row(const char* key, const char* rowKey) const {
        return list(key) ? textOf(*list(key), rowKey) : "(no list)";
    }
    /// A running value of the state, or of its "ExtraInfo"; -1 when there is none.
    std::int64_t kept(const char* key) const { return integerOf(state, key); }
    std::int64_t extra(const char* key) const { return integerOf(*state["ExtraInfo"].dictionary(), key); }
    /// The raw records since the last call.
    Bytes rawLog() {
        generator.generateLogUsingState(state);
        return *state["DisplayState"].data();
    }

    std::vector<RecordingLog::Line> log() {
        std::vector<RecordingLog::Line> lines = _log.lines();
        _log.clear();
        return lines;
    }

    C2KLogGenerator generator;
    DictionaryRef display = Dictionary::make();
    DictionaryRef lookup = Dictionary::make();
    Dictionary state;

private:
    static std::string textOf(const Dictionary& values, const char* key) {
        const Value* value = values.find(key);
        if (value == nullptr) return "(absent)";
        return value->string() != nullptr ? *value->string() : "(no text)";
    }
    static std::int64_t integerOf(const Dictionary& values, const char* key) {
        const Number* number = values[key].number();
        return number != nullptr ? number->integer() : -1;
    }

    RecordingLog _log;
};

using Lines = std::vector<RecordingLog::Line>;

}  // namespace kelvo::test
