#include "packaging/manual/Description.h"

#include <CLI/CLI.hpp>
#include <algorithm>

namespace kelvo::manual {
namespace {

// Help breaks its lines by hand.
std::string inOneLine(std::string text) {
    std::replace(text.begin(), text.end(), '\n', ' ');
    while (text.ends_with(' ')) text.pop_back();
    return text;
}

std::vector<std::string> namesOf(const CLI::Option& option) {
    std::vector<std::string> names;
    for (const std::string& name : option.get_snames()) names.push_back("-" + name);
    for (const std::string& name : option.get_lnames()) names.push_back("--" + name);
    if (names.empty()) names.push_back(option.get_name(true));
    return names;
}

std::vector<std::string> sortedNames(const std::set<CLI::Option*>& options) {
    std::vector<std::string> names(options.size());
    std::transform(options.begin(), options.end(), names.begin(),
                   [](const CLI::Option* option) { return namesOf(*option).back(); });
    std::sort(names.begin(), names.end());
    return names;
}

Argument describeArgument(const CLI::Option& option) {
    Argument argument;
    argument.names = namesOf(option);
    argument.text = inOneLine(option.get_description());
    argument.isRequired = option.get_required();
    argument.needs = sortedNames(option.get_needs());
    argument.excludes = sortedNames(option.get_excludes());
    if (option.get_expected_max() == 0) return argument;
    argument.type = option.nonpositional() ? option.get_type_name() : argument.names.front();
    argument.type = argument.type.substr(
        0, argument.type.find(':') == std::string::npos || argument.type.find('|') != std::string::npos
               ? std::string::npos
               : argument.type.find(':'));  // without the names of checks
    argument.initial = option.get_default_str();
    argument.repeats = option.get_expected_max() > 1;
    argument.valueIsOptional = option.get_expected_min() == 0;
    return argument;
}

void addArguments(Description& description, const CLI::App& app) {
    for (const CLI::Option* option : app.get_options()) {
        const bool named = option->nonpositional();
        (named ? description.options : description.positionals).push_back(describeArgument(*option));
    }
}

}  // namespace

Description describe(const CLI::App& app) {
    Description description;
    description.name = (app.get_parent() != nullptr ? app.get_parent()->get_name() + " " : "") + app.get_name();
    description.text = inOneLine(app.get_description());
    description.footer = app.get_footer();
    addArguments(description, app);
    for (const CLI::App* one : app.get_subcommands([](const CLI::App*) { return true; })) {
        if (one->get_name().empty()) {
            addArguments(description, *one);  // a group of options
        } else {
            description.commands.push_back(describe(*one));
        }
    }
    const auto isGeneral = [](const Argument& option) {
        return option.names.back() == "--help" || option.names.back() == "--version";
    };
    std::stable_partition(description.options.begin(), description.options.end(),
                          [&](const Argument& option) { return !isGeneral(option); });
    return description;
}

std::vector<std::string> split(const std::string& text, char separator) {
    std::vector<std::string> parts;
    std::size_t from = 0;
    while (from <= text.size()) {
        const std::size_t end = std::min(text.find(separator, from), text.size());
        parts.push_back(text.substr(from, end - from));
        from = end + 1;
    }
    return parts;
}

}  // namespace kelvo::manual
