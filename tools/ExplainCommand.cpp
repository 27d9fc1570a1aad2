#include "tools/ExplainCommand.h"

#include <fmt/format.h>

#include <algorithm>
#include <memory>
#include <numeric>
#include <string>
#include <utility>
#include <vector>

#include "glossary/Glossary.h"
#include "tools/Command.h"
#include "tools/CommandFailure.h"
#include "tools/StandardOutput.h"

namespace kelvo {

namespace {

struct Options {
    std::string key;
    bool all = false;
};

std::string lowerCase(std::string_view text) {
    std::string lower(text);
    for (char& c : lower) c = c >= 'A' && c <= 'Z' ? static_cast<char>(c - 'A' + 'a') : c;
    return lower;
}

/// How many letters must be put in, taken out or exchanged to make one text of the other.
std::size_t distance(std::string_view a, std::string_view b) {
    std::vector<std::size_t> row(b.size() + 1);
    std::iota(row.begin(), row.end(), std::size_t{0});
    for (std::size_t i = 0; i < a.size(); ++i) {
        std::size_t diagonal = std::exchange(row[0], i + 1);
        for (std::size_t j = 0; j < b.size(); ++j) {
            const std::size_t replaced = diagonal + (a[i] == b[j] ? 0 : 1);
            diagonal = row[j + 1];
            row[j + 1] = std::min({replaced, row[j] + 1, row[j + 1] + 1});
        }
    }
    return row.back();
}

bool isNear(std::string_view wanted, std::string_view key) {
    constexpr std::size_t kShortestPart = 3;
    if (wanted.size() >= kShortestPart && key.find(wanted) != key.npos) return true;
    return distance(wanted, key) <= std::max<std::size_t>(1, std::min(wanted.size(), key.size()) / 4);
}

/// One meaning of a key and where it holds: "LTE", "GSM: UMTS RR Info".
struct Explanation {
    Meaning meaning;
    std::string places;
};

std::vector<Explanation> explanationsOf(std::string_view wanted) {
    std::vector<Explanation> explanations;
    for (const TechnologyNames& names : kTechnologies) {
        for (const Meaning& meaning : meaningsOf(names.technology)) {
            if (lowerCase(meaning.key) != wanted) continue;
            const std::string place =
                meaning.section.empty() ? std::string(names.name) : fmt::format("{}: {}", names.name, meaning.section);
            const auto same = std::ranges::find_if(explanations, [&](const Explanation& one) {
                return one.meaning.sentence == meaning.sentence && one.meaning.standard == meaning.standard;
            });
            if (same == explanations.end()) {
                explanations.push_back({meaning, place});
            } else {
                same->places += "; " + place;
            }
        }
    }
    return explanations;
}

std::vector<std::string> nearKeys(std::string_view wanted) {
    std::vector<std::string> keys;
    for (const TechnologyNames& names : kTechnologies) {
        for (const Meaning& meaning : meaningsOf(names.technology)) {
            if (isNear(wanted, lowerCase(meaning.key))) keys.emplace_back(meaning.key);
        }
    }
    std::ranges::sort(keys);
    keys.erase(std::unique(keys.begin(), keys.end()), keys.end());
    return keys;
}

void explain(const std::string& key) {
    const std::vector<Explanation> explanations = explanationsOf(lowerCase(key));
    if (explanations.empty()) {
        std::string near;
        for (const std::string& one : nearKeys(lowerCase(key))) near += (near.empty() ? "" : ", ") + one;
        throw CommandFailure(fmt::format("no value is called \"{}\"{}", key,
                                         near.empty() ? "; kelvoctl explain --all lists them" : "; there is: " + near));
    }
    std::string text;
    for (const Explanation& one : explanations) {
        text += fmt::format("{}{}  ({})\n  {}\n  {}\n", text.empty() ? "" : "\n", one.meaning.key, one.places,
                            one.meaning.sentence, standardOf(one.meaning));
    }
    writeToStandardOutput(text);
}

void appendTable(std::string& text, std::string_view title, std::span<const Meaning> meanings) {
    text += fmt::format("\n## {}\n\n| value | means | standard |\n|---|---|---|\n", title);
    for (const Meaning& meaning : meanings) {
        const std::string where = meaning.section.empty() ? "" : fmt::format(" ({})", meaning.section);
        text += fmt::format("| **{}**{} | {} | {} |\n", meaning.key, where, meaning.sentence, standardOf(meaning));
    }
}

/// docs/values.md.
void explainAll() {
    std::string text =
        "# Values\n\n"
        "What every value on the screens means, and the standard it comes from; in brackets the screen or list where "
        "a\n"
        "value means something of its own. `kelvoctl explain --all >docs/values.md` writes this page, and a test wants "
        "it\n"
        "to be current; `kelvoctl explain \"Srxlev\"` tells of one value.\n";
    appendTable(text, "LTE", glossary::kLTE);
    appendTable(text, "GSM/UMTS", glossary::kGSM);
    appendTable(text, "UTRAN (TD-SCDMA)", glossary::kUTRAN);
    appendTable(text, "SIM, of LTE, GSM/UMTS and UTRAN", glossary::kSim);
    appendTable(text, "Data contexts, of LTE, GSM/UMTS and UTRAN", glossary::kDataContexts);
    appendTable(text, "CDMA2000 1x and EV-DO", glossary::kCDMA);
    appendTable(text, "IFX, as the simulated modem names its values", glossary::kIFX);
    writeToStandardOutput(text);
}

}  // namespace

void addExplainCommand(CLI::App& app) {
    CLI::App& command = addCommand(app, "explain", "Tells what a value on the screens means");
    const auto options = std::make_shared<Options>();
    CLI::Option* key = command.add_option("KEY", options->key, "A value's name, as the screens write it");
    command.add_flag("--all", options->all, "Tells of every value, as a page in Markdown")->excludes(key);
    command.footer(
        "One sentence, the standard that the value comes from, and the families that mean this by it.\n\n"
        "Examples:\n"
        "  kelvoctl explain Srxlev\n"
        "  kelvoctl explain 'Cell ID'\n");
    command.callback([options] {
        if (options->all) return explainAll();
        if (options->key.empty()) throw CommandFailure("say which value to explain, or --all");
        explain(options->key);
    });
}

}  // namespace kelvo
