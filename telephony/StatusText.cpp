#include "telephony/StatusText.h"

#include <fmt/format.h>

#include <nlohmann/json.hpp>

#include "LogGenerator/CodeNames.h"
#include "telephony/PhoneStatus.h"
#include "telephony/PortStatus.h"

namespace kelvo {
namespace {

std::int64_t integerOf(const Dictionary& entry, std::string_view key) {
    const Number* number = entry[key].number();
    return number != nullptr ? number->integer() : 0;
}

std::string textOf(const Dictionary& entry, std::string_view key) {
    const std::string* text = entry[key].string();
    return text != nullptr ? *text : std::string("?");
}

std::string codeLine(const Dictionary& rate) {
    const Number* code = rate["Code"].number();
    const Number* perSecond = rate["PerSecond"].number();
    return fmt::format("  {:<46}{:>11.1f}{:>14}\n",
                       code != nullptr ? describeCode(static_cast<LogCode>(code->integer())) : "none",
                       perSecond != nullptr ? perSecond->real() : 0, integerOf(rate, "Records"));
}

std::string clientLine(const Dictionary& client) {
    const bool* streaming = client["Streaming"].boolean();
    return fmt::format("  {}: {}, {} delivered, {} waiting, {} dropped\n", textOf(client, "Name"),
                       streaming != nullptr && *streaming ? "streaming" : "not streaming yet",
                       integerOf(client, "Delivered"), integerOf(client, "Waiting"), integerOf(client, "Dropped"));
}

// The lines of an array of dictionaries; "none" when it is empty.
template <class Line>
std::string linesOf(const ArrayRef& entries, Line line) {
    std::string text;
    for (const Value& entry : *entries)
        if (entry.dictionary()) text += line(*entry.dictionary());
    return text.empty() ? "  none\n" : text;
}

nlohmann::ordered_json jsonOf(const Value& value) {
    if (const std::string* text = value.string()) return *text;
    if (const bool* boolean = value.boolean()) return *boolean;
    if (const Number* number = value.number()) {
        if (number->isReal()) return number->real();
        return number->integer();
    }
    auto json = value.array() ? nlohmann::ordered_json::array() : nlohmann::ordered_json::object();
    if (value.array()) {
        for (const Value& element : *value.array()) json.push_back(jsonOf(element));
    } else if (value.dictionary()) {
        for (const Dictionary::Entry& entry : *value.dictionary()) json[entry.key] = jsonOf(entry.value);
    }
    return json;
}

}  // namespace

Result<std::string> statusJson(const Value& answer) {
    if (!answer.dictionary()) return Failure{"the answer is no dictionary"};
    return jsonOf(answer).dump(2, ' ', true, nlohmann::ordered_json::error_handler_t::replace) + "\n";
}

Result<std::string> statusText(const Value& answer) {
    if (!answer.dictionary()) return Failure{"the answer is no dictionary"};
    const Dictionary& status = *answer.dictionary();
    const ArrayRef& codes = status["Codes"].array();
    const ArrayRef& clients = status["Clients"].array();
    if (!codes || !clients) return Failure{"the answer is no status"};
    const std::string state = status["State"] ? fmt::format("State       {}\n", textOf(status, "State")) : "";
    const DictionaryRef& port = status["Port"].dictionary();
    const DictionaryRef& phone = status["Phone"].dictionary();
    return fmt::format("Source      {}\n{}Technology  {}\nRecords     {}\n\n  {:<46}{:>11}{:>14}\n{}\nClients\n{}{}{}",
                       textOf(status, "Source"), state, textOf(status, "Technology"), integerOf(status, "Records"),
                       "Log code", "per second", "in all", linesOf(codes, codeLine), linesOf(clients, clientLine),
                       port ? portStatusText(*port) : "", phone ? phoneStatusText(*phone) : "");
}

}  // namespace kelvo
