#pragma once

#include <map>
#include <string>
#include <vector>

#include "platform/system/Resources.h"

namespace kelvo::test {

/// Resources held in memory: dictionaries by name, and the listing the test wants to see.
class FakeResources final : public Resources {
public:
    Result<DictionaryRef> dictionary(std::string_view name) const override {
        ++loads;
        const auto at = dictionaries.find(std::string(name));
        if (at == dictionaries.end()) return Failure{"no such resource"};
        return at->second;
    }
    std::vector<std::string> pathsOfType(std::string_view type) const override {
        return type == "plist" ? paths : std::vector<std::string>();
    }

    std::map<std::string, DictionaryRef> dictionaries;
    std::vector<std::string> paths;
    mutable int loads = 0;
};

}  // namespace kelvo::test
