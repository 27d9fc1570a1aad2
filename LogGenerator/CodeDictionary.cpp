#include "LogGenerator/CodeDictionary.h"

#include <cstdint>

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

std::vector<std::string> CodeDictionary::allKeys() const {
    std::vector<std::string> keys;
    keys.reserve(_order.size());
    for (LogCode code : _order) keys.push_back(std::to_string(static_cast<std::int32_t>(code)));
    return keys;
}

}  // namespace kelvo
