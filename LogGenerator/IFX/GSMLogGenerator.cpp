#include "LogGenerator/IFX/GSMLogGenerator.h"

#include "LogGenerator/AssertionFailure.h"
#include "LogGenerator/IFX/NumberInText.h"
#include "LogGenerator/ShowFields.h"
#include "platform/encodings/PropertyList.h"
#include "platform/telephony/LogChannelProtocol.h"

namespace kelvo {

namespace {

constexpr std::string_view kSource = "LogGenerator/GSM/GSMLogGenerator";

/// A child in its parent's simplified form.
Value simplifiedChild(const Value& child) {
    Value processed = GSMLogGenerator::processObject(child);
    Value collapsed = GSMLogGenerator::canCollapse(processed);
    return collapsed ? std::move(collapsed) : std::move(processed);
}

/// Keeps the number beside each text that is one. A text that is a list's row has lost its key, so nobody knows what it
/// counts. Recursive as `processObject` is.
void keepNumbers(const Value& tree) {
    const auto keepIn = [](Value& child) {
        const std::string* text = child.string();
        if (text == nullptr) return keepNumbers(child);
        if (const auto reading = numberInText(*text)) child.set(*reading, child.record());
    };
    if (tree.dictionary()) tree.dictionary()->forEachValue(keepIn);
    if (tree.array()) {
        for (const Value& row : *tree.array()) keepNumbers(row);
    }
}

}  // namespace

Value GSMLogGenerator::canCollapse(const Value& object) {
    const DictionaryRef& dictionary = object.dictionary();
    return dictionary && dictionary->size() == 1 ? dictionary->begin()->value : Value();
}

Value GSMLogGenerator::processObject(const Value& object) {
    if (object.string() != nullptr) return object;
    if (object.dictionary()) {
        const DictionaryRef simplified = Dictionary::make();
        simplified->reserve(object.dictionary()->size());
        for (const auto& [key, child] : *object.dictionary()) simplified->set(key, simplifiedChild(child));
        return simplified;
    }
    if (object.array()) {
        const ArrayRef simplified = Array::make();
        // Intended: every array loses its first element.
        for (std::size_t i = 1; i < object.array()->size(); ++i) {
            simplified->append(simplifiedChild((*object.array())[i]));
        }
        return simplified;
    }
    throw AssertionFailure("processObject:", kSource, 78,
                           "Unknown object of type " + std::string(kindName(object.kind())) + " encountered");
}

void GSMLogGenerator::updateState(Dictionary& state, ByteView data) {
    const Result<Value> tree = readPropertyList(data);
    if (!tree) throw AssertionFailure("updateState:withData:", kSource, 90, "Could not deserialize the object");
    Value display;
    showDelivered(display, processObject(*tree));
    keepNumbers(display);
    state.set("DisplayState", *tree);
    state.set("Display", display);
    state.set("ExtraInfo", Dictionary::make());
}

Value GSMLogGenerator::generateLogUsingState(Dictionary& state) {
    updateHistoryInState(state);
    return state["Display"];
}

DictionaryRef GSMLogGenerator::getStartCommand() { return Dictionary::make({{kPLSetState, kPLStateStreaming}}); }

ArrayRef GSMLogGenerator::getSaveContentsFromState(Dictionary& state) {
    const ArrayRef& history = state["History"].array();
    return history ? std::make_shared<Array>(*history) : Array::make();
}

}  // namespace kelvo
