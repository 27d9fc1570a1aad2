#include "tools/share/SharedDisplay.h"

#include <charconv>

#include "tools/share/SharedKeys.h"
#include "tools/share/SharedPayloads.h"

namespace kelvo {

namespace {

constexpr std::string_view kSorted = "_sorted";
constexpr std::string_view kContexts = "PDP Context Info";

/// The longest number that a screen shows of a record has ten digits.
bool isShownText(std::string_view text) {
    constexpr std::size_t kLongest = 64;
    constexpr int kMostDigits = 10;
    int digits = 0;
    for (const char c : text) {
        digits = c >= '0' && c <= '9' ? digits + 1 : 0;
        if (digits > kMostDigits) return false;
    }
    return text.size() <= kLongest;
}

class Display {
public:
    explicit Display(Replacer& replacer) : _replacer(replacer) {}

    Value dictionary(std::string_view section, const Dictionary& entries) {
        const DictionaryRef made = Dictionary::make();
        for (const auto& [key, value] : entries) {
            if (Value other = entry(section, key, value)) {
                made->set(key, std::move(other));
            } else {
                _replacer.tally().removed("entry of a screen that Kelvo does not know");
            }
        }
        return made;
    }

private:
    Value entry(std::string_view section, const std::string& key, const Value& value) {
        const auto identity = identityOf(section, key);
        if (value.string() != nullptr) return text(section, key, *value.string());
        if (value.dictionary() && identity == Identity::Pilot) return pilots(key, *value.dictionary());
        if (value.dictionary()) return isScreen(key) ? dictionary(withoutOrder(key), *value.dictionary()) : Value();
        if (value.array() && isScreen(key)) return list(withoutOrder(key), *value.array());
        return identity ? sharedValue(_replacer, *identity, withoutOrder(key), value) : Value();
    }

    Value text(std::string_view section, std::string_view key, const std::string& text) {
        if (key == kSorted && text == kSorted) return text;
        const auto identity = identityOf(section, key);
        if (!identity) return isScreen(key) && text.empty() ? Value(text) : Value();
        if (*identity == Identity::None) return isShownText(text) ? Value(text) : Value();
        const auto other = _replacer.text(*identity, withoutOrder(key), text);
        return other ? Value(*other) : Value();
    }

    Value list(std::string_view name, const Array& rows) {
        const ArrayRef made = Array::make();
        for (const Value& row : rows) {
            Value other;
            if (name == kContexts) {
                other = sharedContext(_replacer, row);
            } else if (row.string() != nullptr) {
                other = text({}, name, *row.string());
            } else if (row.dictionary()) {
                other = dictionary(name, *row.dictionary());
            }
            if (!other) _replacer.tally().removed("row of a screen that Kelvo does not know");
            if (other) made->append(std::move(other));
        }
        return made;
    }

    /// Levels under "position;offset".
    Value pilots(const std::string& name, const Dictionary& rows) {
        const DictionaryRef made = Dictionary::make();
        for (const auto& [key, value] : rows) {
            if (key == kSorted) {
                made->set(key, kSorted);
                continue;
            }
            const std::size_t middle = key.find(';');
            const auto number = [](std::string_view digits) {
                std::uint16_t read = 0;
                const char* const end = digits.data() + digits.size();
                const auto [at, error] = std::from_chars(digits.data(), end, read);
                return error == std::errc() && at == end ? std::optional(read) : std::nullopt;
            };
            const auto position = number(std::string_view(key).substr(0, middle));
            const auto pilot = middle != key.npos ? number(std::string_view(key).substr(middle + 1)) : std::nullopt;
            if (!position || !pilot || value.string() == nullptr || !isShownText(*value.string())) {
                _replacer.tally().removed("row of a screen that Kelvo does not know");
                continue;
            }
            const std::uint32_t other = _replacer.number(Identity::Pilot, withoutOrder(name), *pilot);
            made->set(std::to_string(*position) + ";" + std::to_string(other), value);
        }
        return made;
    }

    Replacer& _replacer;
};

}  // namespace

Value sharedDisplay(Replacer& replacer, const Value& display) {
    return display.dictionary() ? Display(replacer).dictionary({}, *display.dictionary()) : Value();
}

}  // namespace kelvo
