#include "tools/TechnologyOption.h"

#include <string_view>

#include "tools/CommandFailure.h"

namespace kelvo {

CLI::Option* addTechnologyOption(CLI::App& command, std::optional<Technology>& technology, const std::string& help) {
    const auto read = [&technology](const std::string& word) {
        technology = technologyBy(&TechnologyNames::word, std::string_view(word));
        if (!technology)
            throw CommandFailure("unknown technology " + word + ": there are ifx, gsm, cdma, lte and utran");
    };
    return command.add_option_function<std::string>("--technology", read, help)->type_name("ifx|gsm|cdma|lte|utran");
}

}  // namespace kelvo
