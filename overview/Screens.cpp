#include "overview/Screens.h"

#include <algorithm>
#include <charconv>

#include "model/DisplayPath.h"
#include "platform/values/Array.h"
#include "platform/values/Dictionary.h"

namespace kelvo::overview {
namespace {

const Value kNone;

const Value& childOf(const Value& value, std::string_view name) {
    const DictionaryRef& dictionary = value.dictionary();
    if (!dictionary) return kNone;
    if (const Value* child = dictionary->find(name)) return *child;
    const auto found = std::find_if(dictionary->begin(), dictionary->end(),
                                    [&](const auto& entry) { return nameOfSortedKey(entry.key) == name; });
    return found != dictionary->end() ? found->value : kNone;
}

/// The number at the start of a text, and what follows as its unit.
std::optional<Figure> parsed(const std::string& text) {
    const char* from = text.data();
    const char* const end = from + text.size();
    if (from != end && *from == '+') ++from;  // which from_chars does not take
    Figure figure;
    const auto [rest, error] = std::from_chars(from, end, figure.number);
    if (error != std::errc{}) return std::nullopt;
    figure.unit = std::string(rest, end);
    figure.unit.erase(0, figure.unit.find_first_not_of(' '));
    return figure;
}

}  // namespace

std::optional<Figure> figureOf(const Value& value) {
    if (value.record() == 0 || value.string() == nullptr) return std::nullopt;
    std::optional<Figure> figure;
    if (const auto measurement = value.measurement()) {
        figure = Figure{{}, measurement->number, std::string(measurement->unit), 0};
    } else if (value.reading() == nullptr) {
        figure = parsed(*value.string());  // a modem's own text
    }
    if (!figure) return std::nullopt;
    figure->text = *value.string();
    figure->record = value.record();
    return figure;
}

const Value& Screens::at(std::string_view path) const {
    const Value* value = &_display;
    while (!path.empty()) {
        const std::size_t separator = std::min(path.find('/'), path.size());
        value = &childOf(*value, path.substr(0, separator));
        path.remove_prefix(std::min(separator + 1, path.size()));
    }
    return *value;
}

std::string Screens::text(std::string_view path) const {
    const Value& value = at(path);
    return value.record() != 0 && value.string() != nullptr ? *value.string() : std::string();
}

std::optional<std::int64_t> Screens::whole(std::string_view path) const {
    const std::string shown = text(path);
    std::int64_t number = 0;
    const auto [rest, error] = std::from_chars(shown.data(), shown.data() + shown.size(), number);
    if (error != std::errc{} || rest != shown.data() + shown.size()) return std::nullopt;
    return number;
}

std::optional<Figure> Screens::figure(std::string_view path) const { return figureOf(at(path)); }

std::uint64_t Screens::record(std::string_view path) const {
    const Value& value = at(path);
    std::uint64_t newest = value.record();
    if (value.dictionary()) {
        for (const auto& entry : *value.dictionary()) newest = std::max(newest, entry.value.record());
    }
    return newest;
}

}  // namespace kelvo::overview
