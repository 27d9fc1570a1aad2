#include "tools/import/TimeOption.h"

#include "platform/encodings/IsoDate.h"

namespace kelvo {

CLI::Option* addTimeOption(CLI::App& command, const std::string& name, std::optional<CaptureTime>& time,
                           const std::string& help) {
    return command
        .add_option_function<std::string>(
            name,
            [name, &time](const std::string& text) {
                const auto date = dateFromIso(text.size() == 10 ? text + "T00:00:00Z" : text);
                if (!date) throw CLI::ValidationError(name, text + " is not a time such as 2014-08-29T20:51:07Z");
                time = CaptureTime(std::chrono::duration_cast<std::chrono::nanoseconds>(date->time_since_epoch()));
            },
            help)
        ->type_name("T");
}

}  // namespace kelvo
