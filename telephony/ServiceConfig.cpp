#include "telephony/ServiceConfig.h"

#include <fmt/format.h>

#include <CLI/CLI.hpp>
#include <algorithm>
#include <fstream>

#include "platform/host/HostPaths.h"

namespace kelvo {
namespace {

constexpr std::size_t kLongestFile = 64 * 1024;

Result<std::vector<CLI::ConfigItem>> readItems(const std::filesystem::path& file) {
    std::error_code error;
    if (std::filesystem::is_directory(file, error)) return Failure{"it is a directory"};
    std::ifstream stream(file);
    if (!stream) return Failure{"it cannot be read"};
    std::string text(kLongestFile + 1, '\0');
    stream.read(text.data(), static_cast<std::streamsize>(text.size()));
    text.resize(static_cast<std::size_t>(stream.gcount()));
    if (text.size() > kLongestFile) return Failure{fmt::format("it is longer than {} bytes", kLongestFile)};
    std::istringstream lines(text);
    try {
        return CLI::ConfigTOML().from_config(lines);
    } catch (const std::exception& failure) {
        return Failure{failure.what()};
    }
}

bool isForARun(const std::string& name) {
    static const char* const kNames[] = {"help", "version", "status", "json", "config", "check-config"};
    return std::ranges::find(kNames, name) != std::end(kNames);
}

// A flag is on or off; an option that may stand without a value does so when it is on.
Result<std::optional<std::string>> argumentOf(const CLI::ConfigItem& item, const CLI::Option& option) {
    if (item.inputs.size() != 1) return Failure{item.name + " has no value, or several"};
    const std::string name = "--" + item.name;
    const std::string& value = item.inputs.front();
    const bool isFlag = option.get_expected_max() == 0;
    const bool mayStandAlone = option.get_expected_min() == 0;
    if (value.starts_with('"')) return Failure{item.name + ": its text does not end (# begins a comment)"};
    if (mayStandAlone && value == "false") return std::optional<std::string>();
    if (mayStandAlone && (value == "true" || (value.empty() && !isFlag))) return std::optional(name);
    if (isFlag) return Failure{fmt::format("{} is true or false, not {}", item.name, value)};
    if (value.empty()) return Failure{item.name + " has no value"};
    return std::optional(name + "=" + value);
}

}  // namespace

ConfigPlaces ConfigPlaces::ofHost() {
    constexpr const char* kName = "kelvo/telephonyd.conf";
    return {HostPaths::configDirectory() / kName, std::filesystem::path("/etc") / kName};
}

std::optional<std::filesystem::path> ConfigPlaces::existing() const {
    for (const auto& place : {user, system}) {
        std::error_code error;
        if (std::filesystem::exists(place, error)) return place;
    }
    return std::nullopt;
}

Result<std::vector<std::string>> readServiceConfig(const std::filesystem::path& file, const CLI::App& commandLine) {
    const auto items = readItems(file);
    if (!items) return items.error();
    std::vector<std::string> arguments;
    for (const CLI::ConfigItem& item : *items) {
        if (!item.parents.empty()) return Failure{fmt::format("there is no section {}", item.parents.front())};
        const CLI::Option* option = commandLine.get_option_no_throw("--" + item.name);
        if (option == nullptr) return Failure{"there is no option " + item.name};
        if (isForARun(item.name)) return Failure{fmt::format("{} is for the command line", item.name)};
        if (isGiven(arguments, "--" + item.name)) return Failure{fmt::format("{} stands there twice", item.name)};
        auto argument = argumentOf(item, *option);
        if (!argument) return argument.error();
        if (*argument) arguments.push_back(std::move(**argument));
    }
    return arguments;
}

bool isGiven(const std::vector<std::string>& arguments, const std::string& name) {
    return std::ranges::any_of(arguments,
                               [&](const std::string& one) { return one == name || one.starts_with(name + "="); });
}

}  // namespace kelvo
