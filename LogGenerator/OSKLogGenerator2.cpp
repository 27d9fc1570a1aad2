#include "LogGenerator/OSKLogGenerator2.h"

#include <set>
#include <stdexcept>

#include "LogGenerator/Framing.h"
#include "LogGenerator/UnknownDataException.h"
#include "platform/system/Environment.h"
#include "platform/telephony/LogChannelProtocol.h"

namespace kelvo {

namespace {

constexpr Key kDisplay("Display");

using Parts = std::vector<std::pair<Base*, const Value*>>;

/// The sections' parts of a display. What a section shows belongs to it, whatever its keys are called.
void collectParts(const Value& node, const ClassIndex& sections, Parts& parts) {
    if (node.array()) {
        for (const Value& element : *node.array()) collectParts(element, sections, parts);
    } else if (node.dictionary()) {
        for (const auto& [key, value] : *node.dictionary()) {
            if (Base* section = sections.getClass(key)) {
                parts.emplace_back(section, &value);
            } else {
                collectParts(value, sections, parts);
            }
        }
    }
}

/// A processed node on its way into its parent.
Value storable(Value processed) {
    if (!processed) throw std::invalid_argument("a template holds nothing but dictionaries, arrays and strings");
    return processed;
}

}  // namespace

OSKLogGenerator2::OSKLogGenerator2(std::string name, std::unique_ptr<ClassIndex> cIndexObj)
    : pListName(std::move(name)), cIndex(std::move(cIndexObj)) {
    if (!cIndex) return;
    logLine(Level::Error, "Creating OSKLogGenerator2 object with %p", static_cast<const void*>(cIndex.get()));
    logCreation();
    logLine(Level::Error, "Class Index: %ld", 1L);  // its owners: this generator alone
}

OSKLogGenerator2::~OSKLogGenerator2() {
    logLine(Level::Warning, "OSK_GSMLogGenerator is destructed %p", static_cast<const void*>(this));
}

void OSKLogGenerator2::updateState(Dictionary& state, ByteView data) {
    getDisplayFromState(state);
    updateWithData(data);
    keepRaw(data);
}

void OSKLogGenerator2::updateWithData(ByteView data) {
    if (!cIndex || data.size() < kMinimumMessageSize) return;
    const ByteView packet = stripPrefix(data);
    const std::uint8_t type = packet.front();
    if (type != 1 && type < 255) {
        logLine(Level::Error, "Invalid log type: %x. Dropping.", static_cast<unsigned>(type));
        return;
    }
    const LogCode code = logCode(packet.data());
    const CodeDictionary::Subscribers* subscribers = cIndex->getSubscribers(code);
    if (subscribers == nullptr) return;
    for (Base* section : *subscribers) {
        try {
            section->updateWithData(packet, code);
        } catch (const LogCode_0xFF0000::UnknownDataException&) {
            // It ends here: the section has written its error line, the others go on and the record is kept.
        }
    }
}

const Value& OSKLogGenerator2::getDisplayFromState(Dictionary& state) {
    const Value& before = state[kDisplay];  // stays none when the display is built now
    if (!before) {
        buildDisplay(state);
    } else if (cIndex && before.dictionary() != _boundDisplay.dictionary()) {
        adoptDisplay(before);
    }
    return before;
}

bool OSKLogGenerator2::loadTemplate(Dictionary& state) const {
    if (!cIndex) return false;
    if (state["Template"].dictionary()) return true;
    const Resources* resources = Environment::current().resources;
    if (resources == nullptr) return false;
    const Result<DictionaryRef> loaded = resources->dictionary(pListName);
    if (loaded) state.set("Template", *loaded);
    return static_cast<bool>(loaded);
}

void OSKLogGenerator2::buildDisplay(Dictionary& state) {
    if (!loadTemplate(state)) {
        logLine(Level::Error, "Cannot load template for display");
        return;
    }
    logLine(Level::Warning, "Initialized class index: %p, Self: %p", static_cast<const void*>(cIndex.get()),
            static_cast<const void*>(this));
    cIndex->status();
    _boundDisplay = processTemplate(state["Template"]);
    printDict(_boundDisplay);
    state.set(kDisplay, _boundDisplay);
    state.set("ExtraInfo", Dictionary::make());
}

// A display that another generator has left is taken over when it has a place for every section; one of another
// technology stays as it is.
void OSKLogGenerator2::adoptDisplay(const Value& display) {
    _boundDisplay = display;
    Parts parts;
    collectParts(display, *cIndex, parts);
    std::set<Base*> placed;
    for (const auto& [section, part] : parts) placed.insert(section);
    if (placed.size() < cIndex->getAllNames().size()) return;
    for (const auto& [section, part] : parts) section->updateSectionRef(*part);
}

void OSKLogGenerator2::bindSection(std::string_view name, const Value& displayPart) const {
    Base* section = cIndex ? cIndex->getClass(name) : nullptr;
    if (section != nullptr) section->updateSectionRef(displayPart);
}

Value OSKLogGenerator2::processTemplate(const Value& node) {
    if (node.string() != nullptr) return node;
    if (node.array()) {
        const ArrayRef processed = Array::make();
        for (const Value& element : *node.array()) processed->append(storable(processTemplate(element)));
        return processed;
    }
    if (node.dictionary()) {
        const DictionaryRef processed = Dictionary::make();
        for (const auto& [key, value] : *node.dictionary()) {
            Value part = processTemplate(value);
            bindSection(key, part);
            processed->set(key, storable(std::move(part)));
        }
        return processed;
    }
    logLine(Level::Error, "Received an object of unknown type");
    logLine(Level::Warning, "Processing the template");
    return {};
}

void OSKLogGenerator2::printDict(const Value& node) const {
    if (node.array()) {
        for (const Value& element : *node.array()) printDict(element);
    } else if (node.dictionary()) {
        for (const auto& [key, value] : *node.dictionary()) printDict(value);
    } else if (node.string() == nullptr) {
        logLine(Level::Error, "Received an object of unknown type");
    }
}

Value OSKLogGenerator2::generateLogUsingState(Dictionary& state) {
    Value display = getDisplayFromState(state);
    moveBinDataInto(state);
    updateHistoryInState(state);
    return display;
}

DictionaryRef OSKLogGenerator2::getStartCommand() {
    const ArrayRef ordinary = Array::make();
    const ArrayRef extended = Array::make();
    for (const LogCode code : cIndex ? cIndex->getAllLogCodes() : std::vector<LogCode>()) {
        if (code >= kExtendedLogCodes) {
            extended->append(std::int64_t{code - kExtendedLogCodes});
        } else {
            ordinary->append(std::int64_t{code});
        }
    }
    return Dictionary::make(
        {{kPLSetState, kPLStateStreaming}, {kPLSetOskraLogCodes, ordinary}, {kPLSetPlExtraCodes, extended}});
}

}  // namespace kelvo
