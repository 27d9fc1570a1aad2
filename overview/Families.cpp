#include "overview/Families.h"

#include <algorithm>

namespace kelvo::overview {
namespace {

std::string megahertz(const std::optional<double>& frequency, std::string_view direction) {
    return frequency ? fmt::format("{:.1f} MHz {}", *frequency, direction) : std::string();
}

std::string frequencies(const BandChannel& band) {
    if (band.downMHz && band.upMHz && *band.downMHz == *band.upMHz) return megahertz(band.downMHz, "both ways");
    std::string text = megahertz(band.downMHz, "down");
    if (band.upMHz) text += (text.empty() ? "" : ", ") + megahertz(band.upMHz, "up");
    return text;
}

}  // namespace

Observation observe(Technology technology, const Value& display) {
    switch (technology) {
        case Technology::CDMA: return observeCdma(display);
        case Technology::GSM: return observeGsmUmts(display);
        case Technology::IFX: return observeIfx(display);
        case Technology::LTE: return observeLte(display);
        case Technology::UTRAN: break;
    }
    return observeUtran(display);
}

void add(std::vector<Fact>& facts, std::string_view name, std::string text) {
    if (!text.empty()) facts.push_back({std::string(name), std::move(text)});
}

void addRate(std::vector<Fact>& rates, std::string_view name, const Screens& screens, std::string_view path) {
    std::string text = screens.text(path);
    if (!text.empty()) rates.push_back({std::string(name), std::move(text), screens.figure(path)});
}

std::optional<Measure> measure(std::string_view name, std::optional<Figure> figure, std::optional<Graded> graded) {
    if (!figure) return std::nullopt;
    std::string grade(graded ? gradeOf(gradesOf(*graded), figure->number) : std::string_view());
    return Measure{std::string(name), *std::move(figure), std::move(grade)};
}

void addBand(Observation& seen, const std::vector<BandChannel>& bands) {
    std::string shown;
    for (const BandChannel& band : bands) {
        seen.band += (seen.band.empty() ? "" : " or ") + band.band;
        shown += fmt::format("{}{} ({})", shown.empty() ? "" : " or ", band.band, frequencies(band));
    }
    add(seen.serving, "Band", shown);
}

void addNetwork(Observation& seen, std::string country, std::string network) {
    network.erase(network.find_last_not_of(' ') + 1);
    if (country.empty() || network.empty()) return;
    country.insert(0, 3 - std::min<std::size_t>(country.size(), 3), '0');
    network.insert(0, 2 - std::min<std::size_t>(network.size(), 2), '0');
    add(seen.serving, "Network", country + "-" + network);
}

void addRncAndCell(Observation& seen, std::int64_t identity) {
    add(seen.serving, "Cell identity",
        fmt::format("{} (RNC {}, cell {})", identity, identity >> 16 & 0xFFF, identity & 0xFFFF));
}

void addColorCodes(Observation& seen, std::int64_t bsic) {
    add(seen.serving, "Color codes", fmt::format("NCC {}, BCC {}", bsic / 8 % 8, bsic % 8));
}

void addContexts(Observation& seen, const Value& contexts) {
    for (const Value& row : rowsOf(contexts)) {
        const Screens shown(row);
        Context context;
        const std::string number = shown.text("Context ID");
        context.name = shown.text("APN");
        context.name += context.name.empty() ? named("context", number) : number.empty() ? "" : " (" + number + ")";
        context.text = shown.text("State");
        context.isUp = context.text == "Active";
        for (const char* key : {"PDP Type", "PDP Address"}) {
            const std::string more = shown.text(key);
            if (!more.empty()) context.text += (context.text.empty() ? "" : ", ") + more;
        }
        if (!context.name.empty()) seen.contexts.push_back(std::move(context));
    }
}

std::string identity(std::string_view channel, std::string_view cell) {
    return channel.empty() || cell.empty() ? std::string() : fmt::format("{}, {}", channel, cell);
}

std::vector<Value> rowsOf(const Value& list) {
    if (!list.array()) return {};
    return {list.array()->begin(), list.array()->end()};
}

std::string named(std::string_view name, const std::string& number) {
    return number.empty() ? std::string() : fmt::format("{} {}", name, number);
}

}  // namespace kelvo::overview
