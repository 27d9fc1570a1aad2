#include "LogGenerator/GSM/GSMLogGenerator.h"

#include "LogGenerator/AssertionFailure.h"
#include "platform/PropertyList.h"

namespace kelvo {

namespace {

constexpr std::string_view kSource = "LogGenerator/GSM/GSMLogGenerator";

/// A dictionary or array on its way into its simplified form, `rebuilt`; the children before `next` are done.
class OpenNode {
public:
    explicit OpenNode(const Value& source) : _source(source) {
        if (source.dictionary()) {
            _rebuilt = Dictionary::make();
        } else if (source.array()) {
            _rebuilt = Array::make();
            _next = 1;  // intended: every array loses its first element
        } else {
            throw AssertionFailure("processObject:", kSource, 78,
                                   "Unknown object of type " + std::string(kindName(source.kind())) + " encountered");
        }
    }

    /// The child to simplify next; null when all are done.
    const Value* nextChild() const {
        if (_source.array()) return _next < _source.array()->size() ? &(*_source.array())[_next] : nullptr;
        return _next < _source.dictionary()->size() ? &entry().value : nullptr;
    }
    /// Takes the simplified form of `nextChild`.
    void add(Value child) {
        if (_source.array()) {
            _rebuilt.array()->append(std::move(child));
        } else {
            _rebuilt.dictionary()->set(entry().key, std::move(child));
        }
        ++_next;
    }
    const Value& rebuilt() const { return _rebuilt; }

private:
    const Dictionary::Entry& entry() const { return _source.dictionary()->begin()[static_cast<std::ptrdiff_t>(_next)]; }

    const Value& _source;
    Value _rebuilt;
    std::size_t _next = 0;
};

}  // namespace

Value GSMLogGenerator::canCollapse(const Value& object) {
    const DictionaryRef& dictionary = object.dictionary();
    return dictionary && dictionary->size() == 1 ? dictionary->begin()->value : Value();
}

// The open nodes stand in a list of their own, not on the call stack, which a deep tree would exhaust.
Value GSMLogGenerator::processObject(const Value& object) {
    if (object.string() != nullptr) return object;
    std::vector<OpenNode> open;
    open.emplace_back(object);
    while (true) {
        const Value* child = open.back().nextChild();
        if (child != nullptr && child->string() == nullptr) {
            open.emplace_back(*child);
        } else if (child != nullptr) {
            open.back().add(*child);
        } else {
            const Value done = open.back().rebuilt();
            open.pop_back();
            if (open.empty()) return done;  // the top is never collapsed
            const Value collapsed = canCollapse(done);
            open.back().add(collapsed ? collapsed : done);
        }
    }
}

void GSMLogGenerator::updateState(Dictionary& state, ByteView data) {
    const Result<Value> tree = readPropertyList(data);
    if (!tree) throw AssertionFailure("updateState:withData:", kSource, 90, "Could not deserialize the object");
    const Value display = processObject(*tree);
    state.set("DisplayState", *tree);
    state.set("Display", display);
    state.set("ExtraInfo", Dictionary::make());
}

Value GSMLogGenerator::generateLogUsingState(Dictionary& state) {
    updateHistoryInState(state);
    return state["Display"];
}

DictionaryRef GSMLogGenerator::getStartCommand() { return Dictionary::make({{"SetState", "Streaming"}}); }

ArrayRef GSMLogGenerator::getSaveContentsFromState(Dictionary& state) {
    const ArrayRef& history = state["History"].array();
    return history ? std::make_shared<Array>(*history) : Array::make();
}

}  // namespace kelvo
