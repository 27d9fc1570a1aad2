#include "LogGenerator/CodeDictionary.h"

namespace kelvo {

void CodeDictionary::subscribe(LogCode code, Base& section) {
    Subscribers& subscribers = _subscribers[code];
    if (subscribers.empty()) _order.push_back(code);
    subscribers.push_back(&section);
}

const CodeDictionary::Subscribers* CodeDictionary::find(LogCode code) const {
    const auto at = _subscribers.find(code);
    return at != _subscribers.end() ? &at->second : nullptr;
}

}  // namespace kelvo
