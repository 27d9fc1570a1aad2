#include "telephony/PhoneStatus.h"

#include <fmt/format.h>

#include "platform/encodings/Utf8.h"
#include "telephony/phone/PhoneRecords.h"

namespace kelvo {
namespace {

struct Line {
    const char* key;    ///< in the answer to "GetStatus", and in JSON
    const char* label;  ///< for people
};
// clang-format off
constexpr Line kLines[] = {
    { "Modem",        "Modem"        },
    { "Model",        "Model"        },
    { "Equipment",    "Equipment"    },
    { "Condition",    "It is"        },
    { "Access",       "On"           },
    { "Registration", "Registered"   },
    { "Network",      "Network"      },
    { "Sim",          "SIM"          },
    { "SimOperator",  "SIM operator" },
};
// clang-format on

std::string counted(std::size_t count, const char* one) {
    return fmt::format("{} {}{}", count, one, count == 1 ? "" : "s");
}

}  // namespace

DictionaryRef phoneStatus(const phone::PhoneService& service) {
    const phone::PhoneState& phone = service.phone();
    auto status = Dictionary::make();
    const auto tell = [&](const char* key, const std::string& text) {
        if (!text.empty()) status->set(key, printable(text));
    };
    const auto tellIdentity = [&](const char* key, const std::string& identity) {
        if (!identity.empty()) tell(key, phone::shortened(identity));
    };
    tell("Modem", phone.modem);
    tell("Model", phone.model);
    tellIdentity("Equipment", phone.equipment);
    tell("Condition", phone.condition);
    tell("Access", phone.access);
    tell("Registration", phone.registration);
    tell("Network", phone.network);
    tellIdentity("Sim", phone.sim.iccid);
    tell("SimOperator", phone.simOperator);
    if (phone.cells) status->set("Cells", static_cast<std::int64_t>(phone.cells->size()));
    if (phone.contexts) status->set("Contexts", static_cast<std::int64_t>(phone.contexts->size()));
    const ArrayRef lacks = Array::make();
    for (const std::string& line : service.lacks()) lacks->append(printable(line));
    const std::string missing = phone::missingLevels(phone);
    if (!missing.empty()) lacks->append("LTE serving cell measurements: not told: " + missing);
    status->set("Lacks", lacks);
    return status;
}

std::string phoneStatusText(const Dictionary& phone) {
    std::string text = "\nModemManager\n";
    for (const auto& [key, label] : kLines) {
        if (const std::string* value = phone[key].string()) text += fmt::format("  {:<26}{}\n", label, *value);
    }
    for (const auto& [key, label, one] :
         {std::tuple("Cells", "Cells", "cell"), std::tuple("Contexts", "Data contexts", "context")}) {
        if (const Number* count = phone[key].number())
            text += fmt::format("  {:<26}{}\n", label, counted(static_cast<std::size_t>(count->integer()), one));
    }
    if (const Number* derived = phone["Derived"].number()) {
        text += fmt::format("  {:<26}{} (0xb17f of the levels: priority, limits, thresholds and rules are not told)\n",
                            "Derived", derived->integer());
    }
    const ArrayRef& lacks = phone["Lacks"].array();
    if (!lacks) return text;
    for (const Value& line : *lacks) {
        if (line.string() != nullptr) text += fmt::format("  lacks {}\n", *line.string());
    }
    return text;
}

}  // namespace kelvo
