#include <algorithm>

#include "tools/share/SharedKeys.h"
#include "tools/share/SharedPayloads.h"

namespace kelvo {

namespace {

constexpr std::string_view kUnknown = "entry of a cell monitor under a name that Kelvo does not know";
constexpr std::string_view kUnknownText = "text of a cell monitor whose meaning Kelvo does not know";

/// The parts of one tree. A dictionary keeps its number of entries: with one entry it would be shown as that.
class Tree {
public:
    explicit Tree(Replacer& replacer) : _replacer(replacer) {}

    /// `key` is the one that the value stands under. None for what no cell monitor has.
    Value shared(const std::string& section, const std::string& key, const Value& value) {
        if (const std::string* text = value.string()) return leaf(section, key, *text);
        if (value.dictionary()) return dictionary(key, *value.dictionary());
        if (value.array()) return array(section, key, *value.array());
        return {};
    }

private:
    Value leaf(const std::string& section, const std::string& key, const std::string& text) {
        const auto identity = identityOf(section, key);
        const bool isHarmless = identity == Identity::None && isPlainText(text);
        if (isHarmless || text.empty()) return text;
        if (identity && *identity != Identity::None) {
            if (const auto other = _replacer.text(*identity, key, text)) return *other;
        } else if (isScreen(key) && std::ranges::none_of(text, [](char c) { return c >= '0' && c <= '9'; }) &&
                   isPlainText(text)) {
            return text;  // "none" in place of a screen
        }
        _replacer.tally().removed(kUnknownText);
        return "";
    }

    Value dictionary(const std::string& section, const Dictionary& entries) {
        const DictionaryRef made = Dictionary::make();
        int removed = 0;
        for (const auto& [key, value] : entries) {
            if (!identityOf(section, key) && !isScreen(key)) {
                _replacer.tally().removed(kUnknown);
                made->set("Removed " + std::to_string(++removed), "");
                continue;
            }
            Value other = shared(section, key, value);
            if (!other) return {};
            made->set(key, std::move(other));
        }
        return made;
    }

    /// The first element heads the list and is not shown: a count is one that may stay.
    Value array(const std::string& section, const std::string& key, const Array& elements) {
        const ArrayRef made = Array::make();
        for (const Value& element : elements) {
            const std::string* text = element.string();
            if (made->size() == 0 && text != nullptr) {
                const bool isCount = text->size() <= 2 && isPlainText(*text) &&
                                     std::ranges::all_of(*text, [](char c) { return c >= '0' && c <= '9'; });
                if (!isCount && !text->empty()) _replacer.tally().removed(kUnknownText);
                made->append(isCount ? *text : std::string());
                continue;
            }
            Value other = shared(section, key, element);
            if (!other) return {};
            made->append(std::move(other));
        }
        return made;
    }

    Replacer& _replacer;
};

}  // namespace

Value sharedTree(Replacer& replacer, const Value& tree) {
    return tree.string() != nullptr ? Value("") : Tree(replacer).shared({}, {}, tree);
}

}  // namespace kelvo
