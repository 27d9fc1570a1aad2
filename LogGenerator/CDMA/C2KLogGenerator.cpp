#include "LogGenerator/CDMA/C2KLogGenerator.h"

#include <algorithm>
#include <array>

#include "LogGenerator/CDMA/C2K1xStatus.h"
#include "LogGenerator/CDMA/C2KDataRates.h"
#include "LogGenerator/CDMA/C2KEVDOPilots.h"
#include "LogGenerator/CDMA/C2KEVDOStatus.h"
#include "LogGenerator/CDMA/C2KSystemIdentification.h"
#include "LogGenerator/CDMA/C2KTrafficFER.h"
#include "LogGenerator/CDMA/CDMACodes.h"
#include "LogGenerator/Framing.h"
#include "platform/system/Environment.h"
#include "platform/telephony/LogChannelProtocol.h"

namespace kelvo {

namespace {

struct Decoder {
    LogCode code;
    void (*decode)(ByteView packet, Dictionary& state, const DictionaryRef& lookup);
};

// clang-format off
constexpr std::array<Decoder, 8> kDecoders = {{  // in the order in which the service is asked for them
    { code::kEVDOFingers,    decodeFingerC2I            },
    { code::kEVDOStatus,     decodeEVDOStatus           },
    { code::kEVDOForwardLink, decodeForwardDataRate      },
    { code::kEVDOActiveSet,  decodeActiveSetPilots      },
    { code::k1xStatus,       decode1xStatus             },
    { code::k1xTrafficFrames, decodeTrafficFER           },
    { code::kEVDOReverseLink, decodeReverseDataRate      },
    { code::kCDMASystem,     decodeSystemIdentification },
}};
// clang-format on

bool loadTemplate(Dictionary& state) {
    if (state["Template"].dictionary()) return true;
    const Resources* resources = Environment::current().resources;
    const Result<DictionaryRef> loaded =
        resources != nullptr ? resources->dictionary("C2KTemplate") : Result<DictionaryRef>(Failure{"no resources"});
    if (!loaded) {
        logLine(Level::Error, "Cannot load C2K template for display");
        return false;
    }
    state.set("Template", *loaded);
    return true;
}

void addBinding(std::string_view lookupKey, std::string_view displayKey, const DictionaryRef& display,
                Dictionary& lookup) {
    Value& bindings = lookup.slot(lookupKey);
    if (!bindings.array()) bindings = Array::make();
    bindings.array()->append(Dictionary::make({{"key", displayKey}, {"dict", display}}));
}

}  // namespace

DictionaryRef C2KLogGenerator::getStartCommand() {
    const ArrayRef codes = Array::make();
    for (const Decoder& decoder : kDecoders) codes->append(std::int64_t{decoder.code});
    return Dictionary::make({{kPLSetState, kPLStateStreaming}, {kPLSetOskraLogCodes, codes}});
}

void C2KLogGenerator::processTemplate(const Dictionary& templateDict, const DictionaryRef& storeDisplayIntoDict,
                                      Dictionary& storeLookupIntoDict) {
    for (const auto& [key, value] : templateDict) {
        if (value.dictionary()) {
            const DictionaryRef screen = Dictionary::make();
            processTemplate(*value.dictionary(), screen, storeLookupIntoDict);
            storeDisplayIntoDict->set(key, screen);
        } else if (value.string() != nullptr && *value.string() == "_sorted") {
            storeDisplayIntoDict->set(key, value);
        } else if (value.string() != nullptr) {
            storeDisplayIntoDict->set(key, "");
            addBinding(*value.string(), key, storeDisplayIntoDict, storeLookupIntoDict);
        }
    }
    logLine(Level::Warning, "Processing the template");
}

Value C2KLogGenerator::getDisplayFromState(Dictionary& state) {
    if (const Value& display = state["Display"]) return display;
    if (!loadTemplate(state)) return {};
    const DictionaryRef display = Dictionary::make();
    const DictionaryRef lookup = Dictionary::make();
    processTemplate(*state["Template"].dictionary(), display, *lookup);
    state.set("Display", display);
    state.set("Lookup", lookup);
    state.set("ExtraInfo", Dictionary::make());
    return display;
}

void C2KLogGenerator::updateState(Dictionary& state, ByteView data) {
    getDisplayFromState(state);
    const DictionaryRef lookup = state["Lookup"].dictionary();
    updateFromLog(data, lookup, state);
}

void C2KLogGenerator::updateFromLog(ByteView data, const DictionaryRef& usingLookup, Dictionary& usingState) {
    if (data.size() < kMinimumMessageSize) return;
    const ByteView packet = stripPrefix(data);
    const std::uint8_t type = packet.front();
    if (type != 1) {  // intended: the line is written and the packet decoded all the same
        logLine(Level::Error, "Invalid log type: %x. Dropping.", static_cast<unsigned>(type));
    }
    const LogCode code = logCode(packet.data());
    const auto decoder = std::ranges::find(kDecoders, code, &Decoder::code);
    if (decoder == kDecoders.end()) return;
    decoder->decode(packet, usingState, usingLookup);
    keepRaw(packet);
}

Value C2KLogGenerator::generateLogUsingState(Dictionary& state) {
    Value display = getDisplayFromState(state);
    moveBinDataInto(state);
    updateHistoryInState(state);
    return display;
}

}  // namespace kelvo
