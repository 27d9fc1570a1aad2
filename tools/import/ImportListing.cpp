#include "tools/import/ImportListing.h"

#include <fmt/chrono.h>
#include <fmt/format.h>
#include <fmt/ranges.h>

#include "LogGenerator/CodeNames.h"
#include "tools/doctor/FillableScreens.h"

namespace kelvo {

namespace {

using adaptation::Adapted;

/// "2014-08-29T20:51:07.123Z".
std::string timeText(const std::optional<wire::SystemTime>& time) {
    if (!time) return "-";
    const auto milliseconds = std::chrono::floor<std::chrono::milliseconds>(*time);
    const auto seconds = std::chrono::floor<std::chrono::seconds>(milliseconds);
    return fmt::format("{:%Y-%m-%dT%H:%M:%S}.{:03}Z", fmt::gmtime(std::chrono::system_clock::to_time_t(seconds)),
                       (milliseconds - seconds).count());
}

std::string versionText(const adaptation::RecordKind& kind) {
    if (!kind.version) return "-";
    if (!kind.partVersion) return std::to_string(*kind.version);
    return fmt::format("{}, part 25: {}", *kind.version, *kind.partVersion);
}

std::string fateText(const RecordSurvey::Row& row) {
    switch (row.outcome) {
        case Adapted::Outcome::Passed: return "passed";
        case Adapted::Outcome::Turned: return "adapted";
        case Adapted::Outcome::Refused: break;
    }
    const bool ours = row.refusal != adaptation::Refusal::NotOurs;
    return (ours ? "refused: " : "") + std::string(adaptation::reasonOf(row.refusal));
}

std::vector<FillableScreens> screensOf(const RecordSurvey& survey) {
    return fillableScreens([&](LogCode code) { return survey.shows(code); });
}

}  // namespace

std::string listingText(const RecordSurvey& survey) {
    std::string text = fmt::format("{:<9} {:<15} {:>6} {:>9}  {:<24}  {:<24}  {:<34}  {}\n", "code", "version", "bytes",
                                   "records", "first", "last", "name", "becomes");
    for (const RecordSurvey::Row& row : survey.rows()) {
        const std::string name = nameOfCode(row.kind.code);
        text += fmt::format("0x{:<7x} {:<15} {:>6} {:>9}  {:<24}  {:<24}  {:<34}  {}\n", row.kind.code,
                            versionText(row.kind), row.kind.bytes, row.records, timeText(row.first), timeText(row.last),
                            name.empty() ? "-" : name, fateText(row));
    }
    if (survey.ofFurtherKinds() != 0) text += fmt::format("{} records of further kinds\n", survey.ofFurtherKinds());
    text += "\n";
    for (const FillableScreens& screens : screensOf(survey)) {
        if (screens.filled.empty() && screens.partly.empty()) continue;
        const std::string_view name = namesOf(screens.technology).name;
        if (!screens.filled.empty())
            text += fmt::format("{} screens filled: {}\n", name, fmt::join(screens.filled, ", "));
        if (!screens.partly.empty())
            text += fmt::format("{} screens in part: {}\n", name, fmt::join(screens.partly, ", "));
    }
    for (const std::string& line : survey.meter().lines()) {
        if (line.find(" refused: ") == line.npos) text += line + "\n";
    }
    return text;
}

nlohmann::ordered_json listingJson(const RecordSurvey& survey) {
    using Json = nlohmann::ordered_json;
    Json records = Json::array();
    for (const RecordSurvey::Row& row : survey.rows()) {
        Json json = {{"code", fmt::format("0x{:x}", row.kind.code)}, {"name", nameOfCode(row.kind.code)}};
        if (row.kind.version) json["version"] = *row.kind.version;
        if (row.kind.partVersion) json["partVersion"] = *row.kind.partVersion;
        json["bytes"] = row.kind.bytes;
        json["records"] = row.records;
        if (row.first) json["first"] = timeText(row.first);
        if (row.last) json["last"] = timeText(row.last);
        const bool refused = row.outcome == Adapted::Outcome::Refused;
        const bool ours = !refused || row.refusal != adaptation::Refusal::NotOurs;
        json["becomes"] = !ours ? "not ours" : refused ? "refused" : fateText(row);
        if (refused && ours) json["reason"] = adaptation::reasonOf(row.refusal);
        records.push_back(std::move(json));
    }
    Json screens = Json::object();
    for (const FillableScreens& family : screensOf(survey)) {
        screens[std::string(namesOf(family.technology).name)] = {{"filled", family.filled}, {"partly", family.partly}};
    }
    return {{"records", records}, {"ofFurtherKinds", survey.ofFurtherKinds()}, {"screens", screens}};
}

}  // namespace kelvo
