#include "glossary/Glossary.h"

#include <algorithm>

namespace kelvo {

namespace {

using Tables = std::vector<std::span<const Meaning>>;

Tables tablesOf(Technology technology) {
    using namespace glossary;
    switch (technology) {
        case Technology::IFX: return {kIFX};
        case Technology::GSM: return {kGSM, kSim, kDataContexts};
        case Technology::CDMA: return {kCDMA};
        case Technology::LTE: return {kLTE, kSim, kDataContexts};
        case Technology::UTRAN: return {kUTRAN, kSim, kDataContexts};
    }
    return {};
}

/// Whether `path` is "…/key".
bool endsWith(std::string_view path, std::string_view key) {
    return path.size() > key.size() && path.ends_with(key) && path[path.size() - key.size() - 1] == '/';
}

/// Whether `path` leads through `section` on its way to `key`.
bool leadsThrough(std::string_view path, std::string_view section, std::string_view key) {
    path.remove_suffix(key.size());
    for (std::size_t at = path.find(section); at != path.npos; at = path.find(section, at + 1)) {
        if (at > 0 && path[at - 1] == '/' && path[at + section.size()] == '/') return true;
    }
    return false;
}

const Meaning* exactMeaning(const Tables& tables, std::string_view path) {
    const Meaning* found = nullptr;
    for (const std::span<const Meaning> table : tables) {
        for (const Meaning& meaning : table) {
            if (!endsWith(path, meaning.key)) continue;
            if (meaning.section.empty() && found == nullptr) found = &meaning;
            if (!meaning.section.empty() && leadsThrough(path, meaning.section, meaning.key)) return &meaning;
        }
    }
    return found;
}

bool isNumber(std::string_view text) {
    return !text.empty() && std::ranges::all_of(text, [](char c) { return c >= '0' && c <= '9'; });
}

}  // namespace

std::vector<Meaning> meaningsOf(Technology technology) {
    std::vector<Meaning> meanings;
    for (const std::span<const Meaning> table : tablesOf(technology)) {
        meanings.insert(meanings.end(), table.begin(), table.end());
    }
    return meanings;
}

const Meaning* meaningAt(Technology technology, std::string_view path) {
    const Tables tables = tablesOf(technology);
    while (true) {
        if (const Meaning* meaning = exactMeaning(tables, path)) return meaning;
        const std::size_t separator = path.rfind('/');
        if (separator == path.npos || !isNumber(path.substr(separator + 1))) return nullptr;
        path = path.substr(0, separator);
    }
}

std::string_view standardOf(const Meaning& meaning) {
    return meaning.standard.empty() ? "no standard, the modem's own" : meaning.standard;
}

}  // namespace kelvo
